// The model of the drivers' configuration file, "/etc/hxa.conf": what the kernel drivers keep across reboots.
//
// The model is one for the process. hxal_config_load() and the scans fill it (a scan adds an entry for every adapter serial
// number, FC port WWN and Ethernet MAC that has none), the setters of hxal/config/setters.h change it, hxal_config_sync()
// writes it. It is never emptied.
//
// An adapter entry belongs to a serial number, an IOC entry to the instance N that the file names in its keys: the FC port of
// the keys "hxaN-..." and the Ethernet port of the keys "hxnN-..." share entry N. A value counts only while the bit of its
// setting is in the entry's `flags`. A key without instance gives the setting to the existing entries and sets its bit in
// `config_all`. Entries that come later get it when a setter touches the setting, which then may be no longer that of all.
//
// Every function here may be called on any number of threads, except that what hxal_config_get() returns is read without lock.
#pragma once

#include "hxal/ioc.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // The settings; the number is the bit in `flags` and `config_all`.
    typedef enum
    {
        HXAL_CONFIG_AD_SERIAL = 0,
        HXAL_CONFIG_AD_NAME = 1,
        HXAL_CONFIG_AD_POWER = 2,
        HXAL_CONFIG_PORT_WWN = 3,
        HXAL_CONFIG_PORT_MAC = 4,
        HXAL_CONFIG_PORT_NAME = 5,
        HXAL_CONFIG_ETH_NAME = 6,
        HXAL_CONFIG_PORT_SPEED = 7,
        HXAL_CONFIG_PORT_TOPOLOGY = 8,
        HXAL_CONFIG_PORT_HARDALPA = 9,
        HXAL_CONFIG_PORT_MAXFRSIZE = 10,
        HXAL_CONFIG_PORT_TRUNK = 11,
        HXAL_CONFIG_PORT_ENABLE = 12,
        HXAL_CONFIG_IPFC_ENABLE = 13,
        HXAL_CONFIG_LOG_LEVEL = 14,
        HXAL_CONFIG_VF_ENABLE = 15,
        HXAL_CONFIG_VF_DEFAULT = 16,
        HXAL_CONFIG_VF_LIST = 17,
        HXAL_CONFIG_VPORT = 18,
        HXAL_CONFIG_AUTH_POLICY = 19,
        HXAL_CONFIG_AUTH_ALGO = 20,
        HXAL_CONFIG_AUTH_GROUP = 21,
        HXAL_CONFIG_AUTH_SECRETSOURCE = 22,
        HXAL_CONFIG_AUTH_ENCRYPT = 23,
        HXAL_CONFIG_PATHTOV = 25, // 24 is no setting
        HXAL_CONFIG_QDEPTH = 26,
        HXAL_CONFIG_QOS = 27,
        HXAL_CONFIG_RATELIM = 28,
        HXAL_CONFIG_RATELIM_DEFSPEED = 29,
        HXAL_CONFIG_COALESCE = 30,
        HXAL_CONFIG_DELAY = 31,
        HXAL_CONFIG_LATENCY = 32,
        HXAL_CONFIG_PERSISTENT_BINDING = 33,
        HXAL_CONFIG_CODES = 34, // how many
    } hxal_config_code_t;

    // Authentication of FC-SP (DH-CHAP).
    typedef enum
    {
        HXA_AUTH_ALGO_MD5 = 1,
        HXA_AUTH_ALGO_SHA1 = 2,
        HXA_AUTH_ALGO_MS = 3, // MD5, then SHA-1
        HXA_AUTH_ALGO_SM = 4, // SHA-1, then MD5
    } hxa_auth_algo_t;

    typedef enum
    {
        HXA_AUTH_GROUP_DHNULL = 0,
        HXA_AUTH_GROUP_DH768 = 1,
        HXA_AUTH_GROUP_DH1024 = 2,
        HXA_AUTH_GROUP_DH1280 = 4,
        HXA_AUTH_GROUP_DH1536 = 8,
        HXA_AUTH_GROUP_ALL = 256,
    } hxa_auth_group_t;

    typedef enum
    {
        HXA_AUTH_SECSRC_LOCAL = 1,
        HXA_AUTH_SECSRC_RADIUS = 2,
        HXA_AUTH_SECSRC_TACACS = 3,
    } hxa_auth_secretsource_t;

    enum
    {
        HXAL_CONFIG_ENTRIES = 128,    // adapters, and IOCs
        HXAL_CONFIG_MAX_VPORTS = 255, // virtual ports of an IOC: they share the low byte of its FC address
    };

    typedef struct
    {
        uint32_t flags[4]; // settings present, bit k = setting k
        char id[12];       // serial number; not terminated when it fills the field
        char name[128];
        uint32_t power; // hxa_pm_ds_t
    } hxal_ad_config_t;

    typedef struct hxal_vf_config_s
    {
        int vidx; // number in the key "hxaN-vport-<number>"
        char pwwn[32];
        char nwwn[32];
        char role[16];
        char name[128]; // symbolic name
        uint16_t vf_id;
        struct hxal_vf_config_s* next;
    } hxal_vf_config_t;

    // Texts are terminated. Enumerations are kept as their number: a file may hold any.
    typedef struct
    {
        uint32_t flags[4]; // settings present, bit k = setting k
        char pwwn[32];     // FC port WWN, "10:00:00:05:1e:10:00:00"
        char name[128];    // of the FC port
        char mac[32];      // Ethernet MAC, "00:05:1e:20:00:00"
        char ethname[128]; // of the Ethernet port
        uint32_t speed;    // hxa_pport_speed_t
        uint32_t topology; // hxa_pport_topology_t
        uint8_t alpa;      // hard AL_PA
        uint16_t maxfrsz;  // bytes
        uint32_t trunking; // bitmap of trunked ports
        hxa_boolean_t enable;
        hxa_boolean_t ipfc_enable;
        int log; // hxa_log_severity_t, 1 to 4
        hxa_boolean_t vf_enable;
        uint16_t vf_default_id;
        uint16_t vf_list;        // bitmap of virtual fabric ids
        hxal_vf_config_t* vport; // virtual ports, linked through `next`; none: null
        int vpcount;
        hxa_boolean_t authpolicy;
        uint32_t authalgo;     // hxa_auth_algo_t
        uint32_t authgroup;    // hxa_auth_group_t
        uint32_t authssource;  // hxa_auth_secretsource_t
        char authsstring[512]; // the enciphered secret, decimal numbers separated by ","
        uint16_t pathtov;      // seconds
        uint16_t qdepth;
        hxa_boolean_t binding;
        hxa_boolean_t qos;
        hxa_boolean_t ratelim;
        uint32_t defspeed; // hxa_pport_speed_t
        hxa_boolean_t coalesce;
        uint16_t delay;   // microseconds
        uint16_t latency; // microseconds
    } hxal_ioc_config_t;

    // Numbers that tune the drivers; read, never written back.
    typedef struct
    {
        int msix_disable;
        int num_rports;
        int num_ios;
        int num_tms;
        int num_fcxps;
        int num_ufbufs;
        int reqq_size;
        int rspq_size;
        int num_sgpgs;
        int ioc_auto_recover;
        int ipfc_disable;
        int rport_del_timeout;
        int dma_relaxed_ordering;
        int pcie_max_read_reqsz;
    } hxal_config_tuning_t;

    // What a key without instance gave. It counts only while the setting's bit is in `config_all`.
    typedef struct
    {
        char text[512]; // the value as it was read
        int reached;    // it was given to the entries before this one
    } hxal_config_for_all_t;

    typedef struct
    {
        hxal_ad_config_t adapters[HXAL_CONFIG_ENTRIES];
        hxal_ioc_config_t iocs[HXAL_CONFIG_ENTRIES];
        uint32_t config_all[4]; // settings that the file gave without instance
        hxal_config_for_all_t for_all[HXAL_CONFIG_CODES];
        hxal_config_tuning_t tuning;
        int adapter_lines; // entry that the next adapter line fills; 0 again after each write
    } hxal_config_t;

    // The model, to look at while no other thread changes it. The library owns it.
    const hxal_config_t* hxal_config_get(void);

    // How many adapter entries have a serial number, IOC entries a WWN.
    int hxal_config_ad_get_num(void);
    int hxal_config_ioc_get_num(void);

    // The index of the first entry that belongs to the serial number, WWN or MAC; none: -1. A serial number is compared over
    // its 12 characters. A WWN is compared with what the entry's text converts to, a MAC
    // with the entry's text.
    int hxal_config_ad_lookup(const char* serial);
    int hxal_config_ioc_lookup(wwn_t pwwn);
    int hxal_config_ethioc_lookup(mac_t mac);

    // Give the first entry that has no serial number, WWN or MAC to this one, whether or not another entry has it already.
    // Nothing happens when all 128 are taken, or without a serial number.
    void hxal_config_ad_add(const char* serial);
    void hxal_config_ioc_add(wwn_t pwwn);
    void hxal_config_ethioc_add(mac_t mac);

    // Gives entry `inst` to the WWN. Nothing happens beyond entry 127.
    void hxal_config_ioc_pwwn(uint16_t inst, wwn_t pwwn);

    // Whether the model has exactly this name, which is not empty, for adapter `idx` (from 1), and that adapter is not the one
    // with the serial number: then the name is taken. No such adapter or entry, or a null argument: HXA_FALSE.
    hxa_boolean_t hxal_config_get_ad_name_exists(int idx, const char* name, const char* serial);

    // Whether the model has exactly this name, which is not empty, for port `port_num` of adapter `idx`: that of its FC or FCoE
    // IOC where the port has one, else that of its Ethernet IOC. No such port or entry, or a null name: HXA_FALSE.
    hxa_boolean_t hxal_config_get_port_name_exists(int idx, const char* name, int port_num);

#ifdef __cplusplus
}
#endif
