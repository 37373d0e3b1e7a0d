// The remote FC ports that a logical port has discovered, each named by its port WWN (`rpwwn`) behind the logical port
// (`pwwn`, `vf_id`; see hxal/lport.h).
//
// The requests are the FC driver's: an Ethernet IOC's driver refuses them. "Base port": a logical port WWN of 0 stands for the
// base port, whose WWN is first read from the port's attributes; when that fails, its status is returned and nothing else sent.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/rport.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Make the driver log in to a remote port by its WWN, or forget it.
    hxa_status_t hxal_rport_add(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn);
    hxa_status_t hxal_rport_remove(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn);

    // Attributes and counters, and setting the counters to 0. Base port. `symname` in the attributes may lack its terminator.
    hxa_status_t hxal_rport_get_attr(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, hxa_rport_attr_t* attr);
    hxa_status_t hxal_rport_get_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, hxa_rport_stats_t* stats);
    hxa_status_t hxal_rport_reset_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn);

    // Where the operating system shows the remote target: SCSI host, bus and target number.
    hxa_status_t hxal_rport_get_scsi_address(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, uint32_t* host,
                                             uint32_t* bus, uint32_t* target);

    // The speed to assume for a remote port that does not tell its own (RPSC, FC-LS), for rate limiting.
    hxa_status_t hxal_rport_set_speed(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, wwn_t rpwwn, hxa_pport_speed_t speed);

    // Asks the name server of the fabric for the symbolic port name of the remote port with the address `rport_pid` (GSPN_ID,
    // FC-GS-6), in the name of the logical port `lpwwn`: reads that port's attributes, then sends one frame (hxal_fcpt(), 20 s).
    // The name is cut to 254 characters and terminated. It is untouched when the name server answers with an empty name or not
    // at all, although that is HXA_STATUS_OK, and whenever the status is another one:
    //     HXA_STATUS_PORT_OFFLINE  the logical port has no address
    //     HXA_STATUS_FABRIC_RJT    the name server does not accept the request
    //     any other                of the attributes, or of the pass-through
    hxa_status_t hxal_get_rport_symname(const hxal_t* ioc, uint16_t vf_id, uint32_t rport_pid, wwn_t lpwwn, wwn_t rpwwn,
                                        hxa_rport_symname_t* symname);

#ifdef __cplusplus
}
#endif
