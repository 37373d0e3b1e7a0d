// Asynchronous event notifications (AEN): what happens to adapters, ports, logical ports, remote ports, initiator-target
// nexus, IOCs and Ethernet ports, and to the audit trail of a port.
//
//     hxal_port_aen_cbhandle_t* handle;
//     hxal_port_aen_register(ioc, on_port_event, cookie, &(hxa_port_aen_data_t){.pwwn = ioc->pwwn}, &handle);
//     hxal_aen_init();
//     ...
//     hxal_aen_exit();
//     hxal_port_aen_unregister(handle);
//
// The drivers queue events for each application (hxal_libinit()). One thread of the library fetches them and calls the
// callbacks that were registered for the object concerned: each matching one once for an event, the newest registration
// first, one callback at a time. A callback may use the whole library, register and unregister included, and what it
// registers is considered for the same event. The thread holds no lock meanwhile and blocks signals. Events are fetched
// only from drivers that a registration was made on, and from the IOCs of the last scan: do not scan while the thread runs. A
// scan ends what registrations hear: they wait on the node as it was open before. After it, unregister them and register anew,
// with the handles that the scan has made.
//
// A callback gets the `userData` of its registration, the event (an hxa_..._aen_event_t, or a number this library does not
// know), the driver's data, which is valid during the call, and the driver's time stamp. When unregister returns no new call
// begins; one that runs on the event thread at that moment goes on.
#pragma once

#include "hxal/adapter.h"
#include "hxal/records/aen.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Starts the event thread. After a round in which readable drivers delivered nothing it rests: an IOC whose fetch keeps
    // failing delays the events of the others by up to 1 s. HXA_STATUS_OK, also when it runs already, and without starting one
    // for an application that queues no events (hxa_aen_app_tessik). Else the status of the error that creating the thread met.
    // Called from a callback it takes back an hxal_aen_exit() of a callback; HXA_STATUS_FAILED when another thread waits for the
    // end.
    hxa_status_t hxal_aen_init(void);

    // Ends the event thread and waits until it is gone: at once when it is idle, else as long as a callback or a request takes.
    // Whoever calls it holds no lock that a callback takes. Called from a callback it does not wait: the thread ends after the
    // events that were fetched with that one, and is gone after the next init or exit. The end of the process, and the
    // unloading of the library, call it too. A child of fork(2) has no event thread.
    void hxal_aen_exit(void);

    // One request: fetches the events that the driver holds for an application on an IOC. `*count` tells the room in `out`, 64
    // at most are asked for, and then how many the driver says that it delivered. Prints a message when the request fails; then
    // nothing is changed.
    hxa_status_t hxal_aen_get_events(const hxal_t* ioc, hxa_aen_entry_t* out, int* count, hxa_aen_app_t app);

    // The event code of the SNIA Common HBA API (INCITS 386, FC-HBA) for an event; 0 for those it does not know.
    uint32_t hxal_snia_event_convert(uint32_t category, uint32_t event);

    // One registration each; opaque.
    typedef struct hxal_adapter_aen_cbhandle_s hxal_adapter_aen_cbhandle_t;
    typedef struct hxal_port_aen_cbhandle_s hxal_port_aen_cbhandle_t;
    typedef struct hxal_lport_aen_cbhandle_s hxal_lport_aen_cbhandle_t;
    typedef struct hxal_rport_aen_cbhandle_s hxal_rport_aen_cbhandle_t;
    typedef struct hxal_itnim_aen_cbhandle_s hxal_itnim_aen_cbhandle_t;
    typedef struct hxal_audit_aen_cbhandle_s hxal_audit_aen_cbhandle_t;
    typedef struct hxal_ioc_aen_cbhandle_s hxal_ioc_aen_cbhandle_t;
    typedef struct hxal_ethport_aen_cbhandle_s hxal_ethport_aen_cbhandle_t;

    typedef void (*hxal_adapter_aen_cbfn_t)(void* userData, uint32_t event, const hxa_adapter_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_port_aen_cbfn_t)(void* userData, uint32_t event, const hxa_port_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_lport_aen_cbfn_t)(void* userData, uint32_t event, const hxa_lport_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_rport_aen_cbfn_t)(void* userData, uint32_t event, const hxa_rport_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_itnim_aen_cbfn_t)(void* userData, uint32_t event, const hxa_itnim_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_audit_aen_cbfn_t)(void* userData, uint32_t event, const hxa_audit_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_ioc_aen_cbfn_t)(void* userData, uint32_t event, const hxa_ioc_aen_data_t* data, hxa_timeval_t tv);
    typedef void (*hxal_ethport_aen_cbfn_t)(void* userData, uint32_t event, const hxa_ethport_aen_data_t* data, hxa_timeval_t tv);

    // The short forms of the SNIA Common HBA API. A registration with HXAL_AEN_SNIA in its flag is called in this form, and its
    // callback passed as the full form by a cast. `pid` is the FC address of the logical port, 0 when the driver does not tell.
#define HXAL_AEN_SNIA 0x1u
    typedef void (*hxal_adapter_snia_cbfn_t)(void* userData, wwn_t pwwn, uint32_t code);
    typedef void (*hxal_lport_snia_cbfn_t)(void* userData, wwn_t lpwwn, uint32_t code, uint32_t pid);
    typedef void (*hxal_itnim_snia_cbfn_t)(void* userData, wwn_t lpwwn, wwn_t rpwwn, uint32_t code);

    // Register: HXA_STATUS_OK and the handle in `*cbhandle`, where the first call finds it already; HXA_STATUS_EINVAL without a
    // callback, a place for the handle or the data that the filter comes from, HXA_STATUS_ENOMEM. The library keeps the
    // registration, and what it needs of `data` and of the driver's node, until it is unregistered. Without an IOC (null) it
    // waits for events of instance 0xFFFF: none.
    //
    // Which events of its kind a registration gets, besides that they come from the IOC's instance:
    //     adapter   those with the adapter's serial number; without an adapter (null) that any adapter was added
    //     port      those with `pwwn` of the data, and those without a MAC; on an Ethernet IOC those with `mac` of the data
    //     lport     those with `lpwwn` of the data; with 0 there that a logical port is new
    //     rport     those with `lpwwn` of the data
    //     itnim     those with `lpwwn` and `rpwwn` of the data; with 0 in `rpwwn` all of the logical port
    //     audit     those with `pwwn` of the data
    //     ioc       all
    //     ethport   those with the MAC of the IOC; `data` is not used
    hxa_status_t hxal_adapter_aen_register(const hxal_adapter_t* ad, hxal_adapter_aen_cbfn_t cbfn, void* userData,
                                           hxal_adapter_aen_cbhandle_t** cbhandle, uint32_t flag);
    hxa_status_t hxal_port_aen_register(const hxal_t* ioc, hxal_port_aen_cbfn_t cbfn, void* userData,
                                        const hxa_port_aen_data_t* data, hxal_port_aen_cbhandle_t** cbhandle);
    hxa_status_t hxal_lport_aen_register(const hxal_t* ioc, hxal_lport_aen_cbfn_t cbfn, void* userData,
                                         const hxa_lport_aen_data_t* data, hxal_lport_aen_cbhandle_t** cbhandle, uint32_t flag);
    hxa_status_t hxal_rport_aen_register(const hxal_t* ioc, hxal_rport_aen_cbfn_t cbfn, void* userData,
                                         const hxa_rport_aen_data_t* data, hxal_rport_aen_cbhandle_t** cbhandle);
    hxa_status_t hxal_itnim_aen_register(const hxal_t* ioc, hxal_itnim_aen_cbfn_t cbfn, void* userData,
                                         const hxa_itnim_aen_data_t* data, hxal_itnim_aen_cbhandle_t** cbhandle, uint32_t flag);
    hxa_status_t hxal_audit_aen_register(const hxal_t* ioc, hxal_audit_aen_cbfn_t cbfn, void* userData,
                                         const hxa_audit_aen_data_t* data, hxal_audit_aen_cbhandle_t** cbhandle);
    hxa_status_t hxal_ioc_aen_register(const hxal_t* ioc, hxal_ioc_aen_cbfn_t cbfn, void* userData,
                                       hxal_ioc_aen_cbhandle_t** cbhandle);
    hxa_status_t hxal_ethport_aen_register(const hxal_t* ioc, hxal_ethport_aen_cbfn_t cbfn, void* userData,
                                           const hxa_ethport_aen_data_t* data, hxal_ethport_aen_cbhandle_t** cbhandle);

    // Unregister: HXA_STATUS_OK, or HXA_STATUS_FAILED when there is no such registration (any more); then all but adapter, lport
    // and itnim print a message.
    hxa_status_t hxal_adapter_aen_unregister(hxal_adapter_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_port_aen_unregister(hxal_port_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_lport_aen_unregister(hxal_lport_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_rport_aen_unregister(hxal_rport_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_itnim_aen_unregister(hxal_itnim_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_audit_aen_unregister(hxal_audit_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_ioc_aen_unregister(hxal_ioc_aen_cbhandle_t* cbhandle);
    hxa_status_t hxal_ethport_aen_unregister(hxal_ethport_aen_cbhandle_t* cbhandle);

    // The message of an event. The table ends with a row whose id is 0; the rows of one category stand together.
    typedef struct
    {
        int32_t id;         // category in bits 16 to 23, event in bits 0 to 15
        uint32_t rsvd;      // 0
        int32_t severity;   // 1 critical, 2 error, 3 warning, 4 information (hxa_log_severity_t)
        const char* name;   // "HXA_AEN_PORT_ONLINE"
        const char* format; // for printf(3)
        uint8_t int_args;   // integers that the format takes
        uint8_t text_args;  // texts that it takes
    } hxal_aen_msg_t;
    extern const hxal_aen_msg_t hxal_aen_msg_array[];

#ifdef __cplusplus
}
#endif
