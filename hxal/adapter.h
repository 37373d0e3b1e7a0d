// The adapters of this host: cards, each with the IOCs that share its hardware path.
//
// Adapters are numbered from 1 in the order in which their first IOC stands in the IOC list. Each keeps copies of its IOC
// handles, whose `id` is the port number and which are not refreshed before the next scan.
#pragma once

#include "hxal/ioc.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // One adapter. Every text is terminated.
    typedef struct hxal_adapter_s
    {
        char serial_num[13]; // of the first IOC seen: 12 characters and the terminator
        char name[64];       // as the driver keeps it
        char model_descr[128];
        char adapter_hwpath[32];
        int ioccount;
        hxal_t* fcioc_list;  // copies of the FC and FCoE IOCs
        hxal_t* ethioc_list; // copies of the Ethernet IOCs
        int id;              // index, from 1
        hxa_boolean_t cna_capable;
        int port_count; // highest port number seen plus one, 1 to 256
        struct hxal_adapter_s* next;
    } hxal_adapter_t;

    // Scans the IOCs, asks each for its attributes and information, and replaces the adapter list. Returns the adapter count;
    // 0 when there is no adapter, and when any IOC fails: then no adapter is listed and the last error is that IOC's status, or
    // HXA_STATUS_ENOMEM, or unchanged where a driver counts an IOC that it does not have.
    int hxal_adapter_scan(void);

    void hxal_adapter_lib_init(void); // does nothing

    // Adapter count of the last scan.
    unsigned hxal_adapter_get_num(void);
    unsigned hxal_adapter_get_count(void);

    // Look-ups that return the adapter; none: null.
    hxal_adapter_t* hxal_adapter_open_idx(int ad);
    hxal_adapter_t* hxal_adapter_get_by_idx(int ad);
    hxal_adapter_t* hxal_adapter_lookup(const char* serial);

    // Look-ups that return the index of the first adapter that fits; none: 0, except where it says -1.
    int hxal_adapter_open_by_name(const char* name); // serial number or name
    unsigned hxal_adapter_get_idx_by_name(const char* name);
    unsigned hxal_adapter_get_idx_by_sn(const char* serial);
    unsigned hxal_adapter_get_idx_by_hwpath(const char* hwpath);
    int hxal_adapter_open_by_wwn(wwn_t wwn);     // port or node WWN of an FC or FCoE IOC
    int hxal_adapter_get_by_pwwn(wwn_t wwn);     // the same; none: -1
    unsigned hxal_adapter_get_by_mac(mac_t mac); // MAC of an FCoE or Ethernet IOC

    // Look-ups that return a port number; none, or no such adapter: -1. The lowest port that fits wins.
    int hxal_adapter_get_ioc_idx_by_pwwn(int ad, wwn_t wwn); // port or node WWN
    int hxal_adapter_get_ioc_idx_by_mac(int ad, mac_t mac);  // MAC of an Ethernet IOC
    int hxal_adapter_get_ioc_idx_by_hwpath(int ad, const char* hwpath);
    int hxal_adapter_get_pcifn(wwn_t pwwn); // on whichever adapter has it

    // The copy of an IOC handle; none: null.
    hxal_t* hxal_adapter_get_fcioc(const hxal_adapter_t* ad, int port);
    hxal_t* hxal_adapter_get_ethioc(const hxal_adapter_t* ad, int port);
    hxal_t* hxal_adapter_get_ioc(const hxal_adapter_t* ad, int port); // the FC one, else the Ethernet one
    hxal_t* hxal_adapter_get_first_ioc(const hxal_adapter_t* ad);     // of port 0, else any; FC before Ethernet
    hxal_t* hxal_adapter_get_port(int ad);                            // the first IOC of adapter `ad`

    // The handle in the IOC list (no copy) whose port WWN is that of the adapter's port with this port or node WWN; none: null.
    hxal_t* hxal_adapter_get_port_by_wwn(int ad, wwn_t wwn);

    // Fields by adapter, or by adapter and port. None: null, 0 for a WWN, -1 for a count, HXA_FALSE.
    const char* hxal_adapter_get_fcioc_hwpath(const hxal_adapter_t* ad, int port);
    const char* hxal_adapter_get_ethioc_hwpath(const hxal_adapter_t* ad, int port);
    wwn_t hxal_adapter_get_ioc_pwwn(const hxal_adapter_t* ad, int port);
    int hxal_adapter_get_num_ioc(int ad);
    int hxal_adapter_get_num_port(int ad);
    const char* hxal_adapter_get_serial_num_by_idx(uint16_t ad);
    hxa_boolean_t hxal_adapter_is_cna_capable(int ad);

    // Copy a text out; the buffers hold 12, 128 and 32 bytes. Each is terminated, but for a serial number of 12 characters, which
    // fills its buffer. Without an adapter nothing is written.
    void hxal_adapter_get_serial_num(const hxal_adapter_t* ad, char* serial);
    void hxal_adapter_get_model(const hxal_adapter_t* ad, char* model);
    void hxal_adapter_get_hw_path(const hxal_adapter_t* ad, char* hwpath);

    // Asks the first IOC for the adapter's name, stores it and returns it; the stored one when the request fails. None: null.
    const char* hxal_adapter_get_name(unsigned ad);

    // Names the adapter: its first IOC's driver, then the other driver through port 0, if there is one; at most 64
    // characters reach them. What they accept becomes the adapter's `name` (63 characters) and is recorded in the
    // configuration. The result is the last error:
    //     HXA_STATUS_OK           named
    //     HXA_STATUS_NO_ADAPTER   there is no such adapter, or it has no IOC
    //     HXA_STATUS_FAILED       a request failed
    //     HXA_STATUS_EINVAL       no name
    //     what the driver says    it refuses the name
    void hxal_adapter_set_name(unsigned ad, const char* name);

    // Whether every IOC of the adapter answers that it is operational, or disabled. A request that fails is a no; the IOCs
    // behind the first no are not asked.
    hxa_boolean_t hxal_adapter_is_enabled(int ad);
    hxa_boolean_t hxal_adapter_is_disabled(int ad);

    // Start and stop every IOC of the adapter one after another, port by port, the FC or FCoE IOC of a port first, also behind
    // one that fails; each may take 20 s (see hxal_ioc_enable()). They return HXA_STATUS_OK, or of what failed the last, or
    //     HXA_STATUS_FAILED         there is no such adapter
    //     HXA_STATUS_AD_IS_ENABLE   all its IOCs were enabled before; enabling asks for their attributes first
    // An IOC that is enabled already is no failure of enabling; one that is disabled already is one of disabling.
    hxa_status_t hxal_adapter_enable(int ad);
    hxa_status_t hxal_adapter_disable(int ad);

    // Sets the power state through the first IOC, in the same order, that accepts it, and records it in the configuration. When
    // none does: what the last one answered, HXA_STATUS_FAILED without any. HXA_STATUS_EINVAL without an adapter.
    hxa_status_t hxal_adapter_set_power(const hxal_adapter_t* ad, hxa_pm_ds_t state);

    // After a scan of the IOCs alone: gives the descriptor of `ioc` to the first FC copy of the adapter (to the first Ethernet
    // copy when `ioc` is an Ethernet IOC).
    void hxal_adapter_update_ioc(int ad, const hxal_t* ioc);

#ifdef __cplusplus
}
#endif
