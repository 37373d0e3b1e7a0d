#include "operation_table.h"

namespace
{

hxa_pport_rnid_t identification()
{
    hxa_pport_rnid_t info{};
    for (std::uint8_t at = 0; at < sizeof info; ++at)
        reinterpret_cast<std::uint8_t*>(&info)[at] = static_cast<std::uint8_t>(0x40 + at);
    return info;
}

} // namespace

const std::vector<Operation>& port_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_port_get_attr", .fc_group = 'C', .ll_group = 'D', .number = 0x2D, .size = 376,
         .call = [](hxal_t* ioc, void* out) { return hxal_port_get_attr(ioc, static_cast<hxa_pport_attr_t*>(out)); },
         .copied = {{8, 368}}},
        {.name = "hxal_port_reset_stats", .fc_group = 'C', .ll_group = 'D', .number = 0x31, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_port_reset_stats(ioc); }},
        {.name = "hxal_port_cfg_topology", .fc_group = 'C', .ll_group = 'D', .number = 0x32, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_port_cfg_topology(ioc, HXA_PPORT_TOPOLOGY_LOOP); },
         .sent = {{8, {2}}}, .fc_recorded = {"hxa1-port-topology = \"loop\";"}},
        {.name = "hxal_port_cfg_speed", .fc_group = 'C', .ll_group = 'D', .number = 0x33, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_port_cfg_speed(ioc, HXA_PPORT_SPEED_8GBPS); },
         .sent = {{8, {8}}}, .fc_recorded = {"hxa1-port-speed = 8;"}},
        {.name = "hxal_port_cfg_hardalpa", .fc_group = 'C', .ll_group = 'D', .number = 0x34, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_port_cfg_hardalpa(ioc, 0xEF); },
         .sent = {{8, {0xEF}}}, .fc_recorded = {"hxa1-port-hardalpa = 0xef;"}},
        {.name = "hxal_port_clr_hardalpa", .fc_group = 'C', .ll_group = 'D', .number = 0x35, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_port_clr_hardalpa(ioc); }},
        {.name = "hxal_port_cfg_maxfrsize", .fc_group = 'C', .ll_group = 'D', .number = 0x36, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_port_cfg_maxfrsize(ioc, 0x0804); },
         .sent = {{6, {0x04, 0x08}}}, .fc_recorded = {"hxa1-port-maxfrsize = 2052;"}},
        {.name = "hxal_port_trunk_enable", .fc_group = 'C', .ll_group = 'D', .number = 0x37, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_port_trunk_enable(ioc, 0x70503); },
         .sent = {{6, {0x03}}}, .fc_recorded = {"hxa1-port-trunk = 0, 1, 8, 10, 16, 17, 18;"}},
        {.name = "hxal_port_trunk_disable", .fc_group = 'C', .ll_group = 'D', .number = 0x38, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_port_trunk_disable(ioc); }},
        {.name = "hxal_port_cfg_rnid_info", .fc_group = 'C', .ll_group = 'D', .number = 0x39, .size = 56,
         .call = [](hxal_t* ioc, void*) { return hxal_port_cfg_rnid_info(ioc, identification()); },
         .sent = {{8, bytes_of(identification())}}},
        {.name = "hxal_port_get_rnid_info", .fc_group = 'C', .ll_group = 'D', .number = 0x3A, .size = 56,
         .call = [](hxal_t* ioc, void* out) { return hxal_port_get_rnid_info(ioc, static_cast<hxa_pport_rnid_t*>(out)); },
         .copied = {{8, 44}}},
    };
    // clang-format on
    return operations;
}

const std::vector<Operation>& fcoe_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_fcoe_port_enable", .fc_group = 'C', .ll_group = 'D', .number = 0x2B, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_fcoe_port_enable(ioc); }},
        {.name = "hxal_fcoe_port_disable", .fc_group = 'C', .ll_group = 'D', .number = 0x2C, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_fcoe_port_disable(ioc); },
         .fc_recorded = {"hxa1-port-enable = \"FALSE\";"}},
        {.name = "hxal_fcoe_reset_stats", .fc_group = 0xC1, .ll_group = 'D', .number = 0x02, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_fcoe_reset_stats(ioc); }},
    };
    // clang-format on
    return operations;
}

const std::vector<Operation>& ethport_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_ethport_get_attr", .fc_group = 'C', .ll_group = 'D', .number = 0x43, .size = 24,
         .call = [](hxal_t* ioc, void* out) { return hxal_ethport_get_attr(ioc, static_cast<hxa_ethport_attr_t*>(out)); },
         .copied = {{8, 16}}},
        {.name = "hxal_ethport_get_stats", .fc_group = 'C', .ll_group = 'D', .number = 0x42, .size = 288,
         .call = [](hxal_t* ioc, void* out) { return hxal_ethport_get_stats(ioc, static_cast<hxa_ethport_stats_t*>(out)); },
         .copied = {{8, 280}}, .printed_on_error = "IOCTL ERR  IOCMD_ETHPORT_GET_STATS   No such device or address\n"},
        {.name = "hxal_ethport_reset_stats", .fc_group = 'C', .ll_group = 'D', .number = 0x31, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_ethport_reset_stats(ioc); }},
    };
    // clang-format on
    return operations;
}
