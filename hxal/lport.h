// The logical FC ports on a physical port: the base port and the virtual ports, each named by its port WWN (`pwwn`) and the
// virtual fabric (`vf_id`, 0 where there is only one) that it logs into.
//
// The requests are the FC driver's: an Ethernet IOC's driver refuses them.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/lport.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Reads the attributes: state, FC address, how it is configured, the fabric that it is logged in to.
    hxa_status_t hxal_lport_get_attr(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, hxa_port_attr_t* attr);

    // Sets the counters of the logical port to 0; hxal_lport_get_stats() reads them.
    hxa_status_t hxal_lport_reset_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn);

    // Lists the port WWNs of the remote ports that the logical port has discovered. `*nrports` is the room in `rports`, in
    // entries, and after a request that did not fail the count as the driver gives it: do not trust it beyond the room.
    // `rports` may be null when the room is 0.
    hxa_status_t hxal_lport_get_rports(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t* rports, uint32_t* nrports);

#ifdef __cplusplus
}
#endif
