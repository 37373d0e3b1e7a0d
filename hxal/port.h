// The physical port behind an IOC: its attributes and configuration, and taking it out of service and back.
//
// Every operation of one request works on the handle's own node: the FC or FCoE function, or the Ethernet function of a
// converged port. A setting that the driver accepts (HXA_STATUS_OK) is also recorded in the configuration model, so that
// hxal_config_sync() keeps it across reboots; one that it refuses is not.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/port.h"
#include "hxal/records/port_config.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads the port's attributes: names, link, configuration.
    hxa_status_t hxal_port_get_attr(const hxal_t* ioc, hxa_pport_attr_t* attr);

    // The text of hxal_pport_states_to_string() for the states 0 to 13; "Unknown" for any other.
    const char* hxal_port_get_state_name(uint32_t state);

    // Sets the counters of the port to 0; hxal_port_get_stats() and hxal_ethport_get_stats() read them.
    hxa_status_t hxal_port_reset_stats(const hxal_t* ioc);

    // Put both functions of the port that `ioc` belongs to into service, or out of it: the FC or FCoE IOC first, then the
    // Ethernet IOC, whichever of them the adapter has; each with one request as hxal_fcoe_port_enable() and
    // hxal_fcoe_port_disable() send it. The second is tried also when the first fails; its status is returned only when the
    // first one succeeded. HXA_STATUS_FAILED, without a request, when the last adapter scan listed no adapter with the hardware
    // path of `ioc`, or no IOC on its port number.
    //
    // Enabling first asks both whether a loopback test holds the port (hxal_diag_get_lb_status()), and returns the first answer
    // that is not HXA_STATUS_OK without enabling anything.
    hxa_status_t hxal_port_enable(const hxal_t* ioc);
    hxa_status_t hxal_port_disable(const hxal_t* ioc);

    // Configure the port. The new values show in `pport_cfg` of the attributes; what the link runs with shows beside it.
    hxa_status_t hxal_port_cfg_topology(const hxal_t* ioc, hxa_pport_topology_t topo);
    hxa_status_t hxal_port_cfg_speed(const hxal_t* ioc, hxa_pport_speed_t speed);
    hxa_status_t hxal_port_cfg_maxfrsize(const hxal_t* ioc, uint16_t maxfrsize); // data field of a frame, bytes

    // The address that the port asks for on an arbitrated loop (AL_PA, FC-AL-2), instead of any free one; back to any.
    hxa_status_t hxal_port_cfg_hardalpa(const hxal_t* ioc, uint8_t alpa);
    hxa_status_t hxal_port_clr_hardalpa(const hxal_t* ioc);

    // Join physical ports of the adapter into one link; part them again. Bit i of `pp_bmap` stands for port i; the driver
    // knows the ports 0 to 7 only.
    hxa_status_t hxal_port_trunk_enable(const hxal_t* ioc, uint32_t pp_bmap);
    hxa_status_t hxal_port_trunk_disable(const hxal_t* ioc);

    // What the port answers to others that ask for its identification (RNID, FC-LS). The configuration model does not keep it.
    hxa_status_t hxal_port_cfg_rnid_info(const hxal_t* ioc, hxa_pport_rnid_t info);
    hxa_status_t hxal_port_get_rnid_info(const hxal_t* ioc, hxa_pport_rnid_t* info);

#ifdef __cplusplus
}
#endif
