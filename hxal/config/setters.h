// The settings that a driver has accepted, recorded in the configuration model. Call a setter after the request's status 0.
//
// A setter finds the IOC entry by the handle's port WWN; where it says so, by the MAC or the adapter's serial number. It does
// nothing when the model has no such entry, also for a handle without WWN (0: Ethernet IOCs have none) and for a null argument.
//
// It stores the value and keeps the setting in the entry only under the condition given: a value that is the driver's default
// needs no line in the file. When the file gave the setting for all instances (`config_all`) and the entry's value changes, the
// setting is from then on written per instance.
//
// Setters change memory only; hxal_config_sync() writes. Every one may be called on any number of threads.
#pragma once

#include "hxal/config/model.h"
#include "hxal/records/lport.h"
#include "hxal/records/port.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Adapter settings. The name goes into the entry of adapter `ad` (from 1), found by its serial number; kept when it is not
    // empty. The power state goes into entry `idx` of the model - hxal_config_ad_lookup() tells the entry of a serial number -
    // and is kept when it is not HXA_PM_DS_D0; an index outside 0 to 127 does nothing.
    void hxal_config_ad_name(int ad, const char* name);
    void hxal_config_ad_ps(int idx, hxa_pm_ds_t power);

    // The port's name: that of the FC port for FC and FCoE IOCs, of the Ethernet port (entry found by MAC) for Ethernet IOCs.
    // Kept when it is not empty.
    void hxal_config_ioc_name(const hxal_t* ioc, const char* name);

    // Port settings, with the condition under which each is kept.
    void hxal_config_topology(const hxal_t* ioc, hxa_pport_topology_t topology);           // not HXA_PPORT_TOPOLOGY_NONE
    void hxal_config_speed(const hxal_t* ioc, hxa_pport_speed_t speed);                    // AUTO is stored as 0; not 0
    void hxal_config_alpa(const hxal_t* ioc, uint8_t alpa, hxa_boolean_t mode);            // mode
    void hxal_config_maxfrsz(const hxal_t* ioc, uint16_t maxfrsize);                       // not 2112
    void hxal_config_trunk(const hxal_t* ioc, uint32_t pp_bmap, hxa_boolean_t mode);       // mode
    void hxal_config_enable(const hxal_t* ioc, hxa_boolean_t enable);                      // disabled
    void hxal_config_ipfc_enable(const hxal_t* ioc, hxa_boolean_t enable);                 // disabled
    void hxal_config_log_level(const hxal_t* ioc, int level);                              // not 0
    void hxal_config_vf_mode(const hxal_t* ioc, uint16_t vf_id, hxa_boolean_t mode);       // mode; the default id: not 1
    void hxal_config_vf_list(const hxal_t* ioc, uint16_t vf_id, hxa_boolean_t mode);       // any fabric left; see below
    void hxal_config_fcpim(const hxal_t* ioc, uint16_t pathtov);                           // seconds; not 0
    void hxal_config_qdepth(const hxal_t* ioc, uint16_t qdepth);                           // not 0
    void hxal_config_pbind(const hxal_t* ioc, hxa_boolean_t binding);                      // on
    void hxal_config_qos(const hxal_t* ioc, hxa_boolean_t qos);                            // on
    void hxal_config_ratelim(const hxal_t* ioc, hxa_boolean_t ratelim);                    // on
    void hxal_config_defspeed(const hxal_t* ioc, hxa_pport_speed_t speed);                 // AUTO is stored as 0; not 1
    void hxal_config_auth_policy(const hxal_t* ioc, hxa_boolean_t on);                     // on
    void hxal_config_auth_algo(const hxal_t* ioc, hxa_auth_algo_t algo);                   // not 0
    void hxal_config_auth_group(const hxal_t* ioc, hxa_auth_group_t group);                // not HXA_AUTH_GROUP_DH768
    void hxal_config_auth_secretsource(const hxal_t* ioc, hxa_auth_secretsource_t source); // not HXA_AUTH_SECSRC_LOCAL

    // hxal_config_vf_list() adds a virtual fabric (mode HXA_TRUE) to the list or takes it out. The list has room for the ids
    // 0 to 15; a larger one does nothing.

    // The shared secret as it left its encipherment: `n` numbers, stored as decimal text separated by ",", as many as fit
    // whole into 511 characters. The library never sees the secret in clear. Kept when the text is not empty. Beyond 488
    // characters its line in the file may be longer than the 511 that hxal_config_load() takes: it would be read back cut.
    void hxal_config_auth_secretstring(const hxal_t* ioc, const uint32_t* words, int n);

    // Interrupt moderation. `coalesce` is always stored, `delay` and `latency` (microseconds) only when coalescing is on. The
    // drivers' default is on, 1125 and 225. Kept: `coalesce` when off; `delay` and `latency` unless both are the defaults, or
    // coalescing is off and the one in question 0.
    void hxal_config_iocfc_intr(const hxal_t* ioc, hxa_boolean_t coalesce, uint16_t delay, uint16_t latency);

    // The virtual ports of the IOC. An addition appends the port, or replaces the one with the same port WWN, and numbers a new
    // one with the lowest free number; nothing happens when memory is short or 255 are there. The roles are stored as the
    // decimal number of their bits. A deletion frees the port with that port WWN, if there is one.
    void hxal_config_vport_add(const hxal_t* ioc, uint16_t vf_id, const hxa_port_cfg_t* port);
    void hxal_config_vport_del(const hxal_t* ioc, wwn_t vpwwn);

#ifdef __cplusplus
}
#endif
