// What the numbers of the drivers mean, in words.
//
// Every function accepts any number, as it came from a driver, and returns a constant text.
#pragma once

#include <stdint.h>

#ifdef __cplusplus
extern "C"
{
#endif

    // "unknown" for a value without a text.
    const char* hxal_flash_status_to_string(uint32_t status);        // hxa_flash_status_t
    const char* hxal_flash_part_type_to_string(uint32_t type);       // hxa_flash_part_type_t, 0 is "null"
    const char* hxal_pm_ds_to_string(uint32_t state);                // hxa_pm_ds_t
    const char* hxal_ioc_state_to_string(uint32_t state);            // hxa_ioc_state_t
    const char* hxal_pport_states_to_string(uint32_t state);         // hxa_pport_states_t, 0 is "Unknown"
    const char* hxal_pport_speed_to_string(uint32_t speed);          // hxa_pport_speed_t, padded to three characters
    const char* hxal_pport_type_to_string(uint32_t type);            // hxa_pport_type_t
    const char* hxal_pport_topology_to_string(uint32_t topology);    // hxa_pport_topology_t
    const char* hxal_pport_linkstate_rsn_to_string(uint32_t reason); // why an Ethernet link is down, 20 to 38
    const char* hxal_ethport_cee_state_to_string(uint32_t state);    // hxa_ethport_cee_state_t
    const char* hxal_qos_state_to_string(uint32_t state);            // hxa_qos_state_t, 0 is "Unknown"
    const char* hxal_qos_priority_to_string(uint32_t priority);      // hxa_qos_priority_t
    const char* hxal_rport_state_to_string(uint32_t state);          // hxa_rport_state_t
    const char* hxal_itnim_state_to_string(uint32_t state);          // hxa_itnim_state_t
    const char* hxal_vport_state_to_string(uint32_t state);          // virtual port, 0 to 9
    const char* hxal_auth_status_to_string(uint32_t status);         // authentication, 0 to 9
    const char* hxal_auth_rej_code_to_string(uint32_t code);         // authentication reject, 1 and 2
    const char* hxal_auth_rej_code_exp_to_string(uint32_t code);     // explanation of the reject, 1 to 10
    const char* hxal_log_severity_to_string(uint32_t severity);      // hxa_log_severity_t

    // Two letters for the medium of a transceiver (hxa_defs_sfp_media_t); "--" when it is unknown or out of range.
    const char* hxal_get_sfp_media(uint32_t media);

    // The module (0 to 8) and event (0 to 24) names of the port log, at most 7 characters; empty out of range.
    const char* hxa_plog_mid_strings(int index);
    const char* hxa_plog_eid_strings(int index);

#ifdef __cplusplus
}
#endif
