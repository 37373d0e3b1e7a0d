// The I/O controllers (IOCs) of this host: one per PCI function that a driver serves.
//
// FC and FCoE IOCs are reached through "/dev/hxa", Ethernet IOCs through "/dev/hxn". A scan lists those of "/dev/hxa" first,
// each node in the order of its driver instances.
#pragma once

#include "hxal/records/ioc.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // The handle of one IOC. Every text is terminated. Ethernet IOCs have no WWNs (0), FC IOCs no MACs.
    typedef struct hxal_s
    {
        int fd;                  // descriptor of the node, shared by all its IOCs; the library closes it
        int instance;            // driver instance
        int port_num;            // port of the card, from 0; set by hxal_adapter_scan()
        char devpath[256];       // "/dev/hxa" or "/dev/hxn"
        char ioc_hwpath[32];     // PCI path of the IOC
        char adapter_hwpath[32]; // PCI path of the card
        char serialnum[13];      // of the card: 12 characters and the terminator
        char name[64];           // of the card, as the driver keeps it
        char port_name[64];      // as the driver keeps it
        char eth_name[64];       // network interface of an Ethernet IOC
        wwn_t pwwn;
        wwn_t nwwn;
        wwn_t factorypwwn;
        wwn_t factorynwwn;
        int id; // index in the IOC list; in the IOC lists of an adapter the port number
        mac_t mac;
        mac_t factory_mac;
        mac_t current_mac;
        hxa_ioc_type_e ioc_type;
        struct hxal_s* next;
    } hxal_t;

    // Replaces the IOC list by what the drivers answer now, and returns the IOC count: the sum of the instance counts of both
    // drivers, which is more than there are handles where a driver counts an instance that its bitmap lacks. A node that fails
    // contributes nothing and leaves its status as last error:
    //     HXA_STATUS_NO_DRIVER    it cannot be opened
    //     HXA_STATUS_EIO          a request of the scan fails, or the driver claims more than 128 instances
    //     HXA_STATUS_ENOMEM       out of memory
    //     what the driver says    it refuses the library's version (HXA_STATUS_VERSION_FAIL) or the information request
    // The descriptors of earlier scans are closed, except those that the adapter list still needs.
    int hxal_ioc_scan(void);

    int hxal_ioc_get_num(void);      // IOC count of the last scan
    hxal_t* hxal_ioc_get_list(void); // first handle of the list, linked through `next`; none: null

    // How many instances the FC driver has at this moment; -1 when its node cannot be opened or fails the request.
    int hxal_ioc_get_inst_num(void);

    // Look-ups that return the handle; none: null.
    hxal_t* hxal_ioc_open_idx(int idx);
    hxal_t* hxal_ioc_open_hwpath(const char* hwpath);   // by `ioc_hwpath`
    hxal_t* hxal_ioc_open_pwwn(wwn_t pwwn);             // FC and FCoE IOCs only
    hxal_t* hxal_ioc_open_name(const char* name);       // by the card's name: its first IOC
    hxal_t* hxal_ioc_get_by_eth_name(const char* name); // by network interface
    hxal_t* hxal_ioc_get_by_inst(int instance);         // both drivers count from 0: the FC driver's comes first
    void hxal_ioc_close(hxal_t* ioc);                   // does nothing: handles live until the next scan

    // Look-ups that return the index; none: -1. Where a type is asked for, FC finds FC and FCoE IOCs, any other type itself.
    int hxal_ioc_get_idx_by_pwwn(wwn_t pwwn);                            // FC and FCoE IOCs only
    int hxal_ioc_get_idx_by_mac(mac_t mac);                              // FCoE and Ethernet IOCs only
    int hxal_ioc_get_idx_by_name(const char* name, hxa_ioc_type_e type); // by `port_name`
    int hxal_ioc_get_fc_idx_by_name(const char* name);
    int hxal_ioc_get_eth_idx_by_name(const char* name);
    int hxal_ioc_get_idx_by_hwpath(const char* hwpath, hxa_ioc_type_e type); // by `ioc_hwpath`
    int hxal_ioc_get_fc_idx_by_hwpath(const char* hwpath);
    int hxal_ioc_get_eth_idx_by_hwpath(const char* hwpath);

    // Look-ups that return the driver instance; none: -1.
    int hxal_ioc_get_inst_num_by_pwwn(wwn_t pwwn); // FC and FCoE IOCs only
    int hxal_ioc_get_inst_num_by_mac(mac_t mac);   // Ethernet IOCs only

    // Copy paths out, terminated; the buffers hold 256, 32 and 32 bytes. Without an IOC nothing is written.
    void hxal_ioc_get_path(const hxal_t* ioc, char* devpath, char* hwpath, char* adapter_hwpath);
    void hxal_ioc_get_path_by_idx(int idx, char* devpath);

    // Fields of a handle. Without one: 0, -1 for the port number, null for the texts.
    wwn_t hxal_ioc_get_pwwn(const hxal_t* ioc);
    wwn_t hxal_ioc_get_nwwn(const hxal_t* ioc);
    mac_t hxal_ioc_get_mac(const hxal_t* ioc);
    mac_t hxal_ioc_get_factory_mac(const hxal_t* ioc);
    int hxal_ioc_get_port_num(const hxal_t* ioc);
    hxa_ioc_type_e hxal_ioc_get_ioc_type(const hxal_t* ioc);
    const char* hxal_ioc_get_name(const hxal_t* ioc); // `port_name`
    const char* hxal_ioc_get_eth_name(const hxal_t* ioc);
    const char* hxal_ioc_get_sn(const hxal_t* ioc); // serial number of the card

    // Asks the driver for the MAC in use, stores it in the handle and returns it; the stored one when the request fails.
    mac_t hxal_ioc_get_current_mac(hxal_t* ioc);

    // Requests, one each: a null handle, name or output is HXA_STATUS_EINVAL without a request.

    // Whether the driver behind the IOC serves this library. A driver of another version that does is HXA_STATUS_OK with a
    // warning on standard output; a request that fails is HXA_STATUS_EIO.
    hxa_status_t hxal_ioc_compare_versions(const hxal_t* ioc);

    // Reads identity, names and addresses. The request is made in `info` itself: also a call that fails overwrites it.
    hxa_status_t hxal_ioc_get_info(const hxal_t* ioc, hxa_ioctl_ioc_info_t* info);

    // Reads the attributes of card, driver and PCI function, with the IOC's state. Prints a message when the call fails.
    hxa_status_t hxal_ioc_get_attr(const hxal_t* ioc, hxa_ioc_attr_t* attr);

    // Read and clear what driver and firmware count.
    hxa_status_t hxal_ioc_get_stats(const hxal_t* ioc, hxa_ioc_stats_t* stats);
    hxa_status_t hxal_ioc_reset_stats(const hxal_t* ioc);

    // Sets the power state of the PCI function (PCI Power Management, D0 is on, D3 off).
    hxa_status_t hxal_ioc_set_power(const hxal_t* ioc, hxa_pm_ds_t state);

    // Names the port: at most 64 characters reach the driver. What it accepts becomes the handle's `port_name` (63
    // characters) and is recorded in the configuration.
    hxa_status_t hxal_ioc_set_name(hxal_t* ioc, const char* name);

    // Start and stop the IOC. What the driver refuses is answered at once. Else they read the attributes once a second, until
    // the IOC is operational or disabled: HXA_STATUS_OK, or HXA_STATUS_FAILED after 20 s. They block as long.
    hxa_status_t hxal_ioc_enable(const hxal_t* ioc);
    hxa_status_t hxal_ioc_disable(const hxal_t* ioc);

#ifdef __cplusplus
}
#endif
