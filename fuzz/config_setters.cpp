// Any row of setters, lines and writes on the configuration model, with any arguments: its lists and their counts stay true.
#include "hxal/config/parser.h"
#include "hxal/config/setters.h"
#include "tests/hxal/config_model.h"

#include <cstdint>
#include <cstring>
#include <fuzzer/FuzzedDataProvider.h>
#include <vector>

namespace
{

class Host
{
public:
    Host(const uint8_t* data, size_t size) : bytes(data, size) {}

    bool is_at_end() { return bytes.remaining_bytes() == 0; }

    void change()
    {
        hxal_t ioc = any_ioc();
        const hxa_boolean_t mode = bytes.ConsumeBool() ? HXA_TRUE : HXA_FALSE;
        const auto number = bytes.ConsumeIntegral<uint16_t>();
        const uint32_t low_bits = number % 16;
        switch (bytes.ConsumeIntegralInRange(0, 26))
        {
        case 0:
            return hxal_config_ioc_name(&ioc, text().c_str());
        case 1:
            return hxal_config_topology(&ioc, static_cast<hxa_pport_topology_t>(number % 4));
        case 2:
            return hxal_config_speed(&ioc, static_cast<hxa_pport_speed_t>(low_bits));
        case 3:
            return hxal_config_alpa(&ioc, static_cast<uint8_t>(number), mode);
        case 4:
            return hxal_config_maxfrsz(&ioc, number);
        case 5:
            return hxal_config_trunk(&ioc, bytes.ConsumeIntegral<uint32_t>(), mode);
        case 6:
            return hxal_config_enable(&ioc, mode);
        case 7:
            return hxal_config_ipfc_enable(&ioc, mode);
        case 8:
            return hxal_config_log_level(&ioc, bytes.ConsumeIntegral<int>());
        case 9:
            return hxal_config_vf_mode(&ioc, number, mode);
        case 10:
            return hxal_config_vf_list(&ioc, number, mode);
        case 11:
            return hxal_config_fcpim(&ioc, number);
        case 12:
            return hxal_config_qdepth(&ioc, number);
        case 13:
            return hxal_config_pbind(&ioc, mode);
        case 14:
            return hxal_config_qos(&ioc, mode);
        case 15:
            return hxal_config_ratelim(&ioc, mode);
        case 16:
            return hxal_config_defspeed(&ioc, static_cast<hxa_pport_speed_t>(low_bits));
        case 17:
            return hxal_config_auth_policy(&ioc, mode);
        case 18:
            return hxal_config_auth_algo(&ioc, static_cast<hxa_auth_algo_t>(number % 8));
        case 19:
            return hxal_config_auth_group(&ioc, static_cast<hxa_auth_group_t>(number % 512));
        case 20:
            return hxal_config_auth_secretsource(&ioc, static_cast<hxa_auth_secretsource_t>(number % 4));
        case 21:
            return set_secret(ioc);
        case 22:
            return hxal_config_iocfc_intr(&ioc, mode, number, bytes.ConsumeIntegral<uint16_t>());
        case 23:
            return add_vport(ioc, number);
        case 24:
            return hxal_config_vport_del(&ioc, any_wwn());
        case 25:
            return hxal_config_ad_ps(bytes.ConsumeIntegral<int>(), static_cast<hxa_pm_ds_t>(number % 4));
        default:
            return hxal_config_parse(text().c_str());
        }
    }

private:
    wwn_t any_wwn() { return bytes.ConsumeIntegralInRange<wwn_t>(0, 3); }
    std::string text() { return bytes.ConsumeRandomLengthString(600); }

    hxal_t any_ioc()
    {
        hxal_t ioc = {};
        ioc.ioc_type = bytes.ConsumeBool() ? HXA_IOC_TYPE_FC : HXA_IOC_TYPE_LL;
        ioc.pwwn = any_wwn();
        return ioc;
    }

    void set_secret(const hxal_t& ioc)
    {
        std::vector<uint32_t> words(bytes.ConsumeIntegralInRange<std::size_t>(0, 300));
        for (uint32_t& word : words)
            word = bytes.ConsumeIntegral<uint32_t>();
        hxal_config_auth_secretstring(&ioc, words.data(), static_cast<int>(words.size()));
    }

    void add_vport(const hxal_t& ioc, uint16_t vf_id)
    {
        hxa_port_cfg_t port = {};
        port.pwwn = any_wwn();
        bytes.ConsumeData(port.sym_name, sizeof port.sym_name);
        port.roles = bytes.ConsumeIntegral<uint32_t>();
        hxal_config_vport_add(&ioc, vf_id, &port);
    }

    FuzzedDataProvider bytes;
};

void check_vports(const hxal_ioc_config_t& entry)
{
    int count = 0;
    for (const hxal_vf_config_t* port = entry.vport; port; port = port->next)
        ++count;
    if (count != entry.vpcount || count > HXAL_CONFIG_MAX_VPORTS ||
        hxal::config::has(entry.flags, HXAL_CONFIG_VPORT) != (count > 0))
        __builtin_trap();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    empty_model();
    for (wwn_t pwwn = 1; pwwn <= 2; ++pwwn)
        hxal_config_ioc_add(pwwn);
    hxal_config_ethioc_add({});
    for (Host host(data, size); !host.is_at_end();)
        host.change();
    for (const hxal_ioc_config_t& entry : hxal_config_get()->iocs)
        check_vports(entry);
    written();
    return 0;
}
