#include "operation_table.h"

namespace
{

std::uint32_t registers[4];

hxa_diag_ledtest_t led_test()
{
    hxa_diag_ledtest_t test{};
    for (std::uint8_t at = 0; at < sizeof test; ++at)
        reinterpret_cast<std::uint8_t*>(&test)[at] = static_cast<std::uint8_t>(0x40 + at);
    return test;
}

} // namespace

const std::vector<Operation>& diag_operations()
{
    static const hxa_diag_ledtest_t lights = led_test();
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_diag_regread", .fc_group = 'C', .ll_group = 'D', .number = 0x0E, .size = 32,
         .call = [](hxal_t* ioc, void*) { return hxal_diag_regread(ioc, 0x01020304, 4, registers); },
         .sent = {{8, {4, 3, 2, 1, 4}}, {24, bytes_of(reinterpret_cast<std::uintptr_t>(registers))}}},
        {.name = "hxal_diag_regwrite", .fc_group = 'C', .ll_group = 'D', .number = 0x10, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_diag_regwrite(ioc, 0x01020304, 0x0A0B0C0D); },
         .sent = {{8, {4, 3, 2, 1, 0x0D, 0x0C, 0x0B, 0x0A}}}},
        {.name = "hxal_diag_tsensor_query", .fc_group = 'C', .ll_group = 'D', .number = 0x11, .size = 8,
         .call = [](hxal_t* ioc, void* out) { return hxal_diag_tsensor_query(ioc, static_cast<uint16_t*>(out)); },
         .copied = {{6, 2}}, .optional_output = true},
        {.name = "hxal_diag_memtest", .fc_group = 'C', .ll_group = 'D', .number = 0x13, .size = 56,
         .call = [](hxal_t* ioc, void* out)
         { return hxal_diag_memtest(ioc, 0x0A0B0C0D, static_cast<hxa_diag_memtest_result_t*>(out)); },
         .sent = {{12, {0x0D, 0x0C, 0x0B, 0x0A}}}, .copied = {{16, 32}}, .optional_output = true},
        {.name = "hxal_diag_loopback", .fc_group = 'C', .ll_group = 'D', .number = 0x14, .size = 48,
         .call = [](hxal_t* ioc, void* out)
         {
             return hxal_diag_loopback(ioc, HXA_PPORT_OPMODE_LB_CBL, HXA_PPORT_SPEED_4GBPS, 1, 0x0A0B0C0D,
                                       static_cast<hxa_diag_loopback_result_t*>(out));
         },
         .sent = {{8, {8, 0, 0, 0, 4}}, {16, {0, 0, 0, 1, 0x0A, 0x0B, 0x0C, 0x0D}}}, .copied = {{24, 24}},
         .optional_output = true},
        {.name = "hxal_diag_eth_loopback", .fc_group = 'C', .ll_group = 'D', .number = 0x1B, .size = 44,
         .call = [](hxal_t* ioc, void* out)
         {
             return hxal_diag_eth_loopback(ioc, HXA_PPORT_OPMODE_LB_EXT, 1, 0x0A0B0C0D,
                                           static_cast<hxa_diag_loopback_result_t*>(out));
         },
         .sent = {{8, {4, 0, 0, 0, 1, 0, 0, 0, 0x0D, 0x0C, 0x0B, 0x0A}}}, .copied = {{20, 24}}, .optional_output = true},
        {.name = "hxal_diag_get_lb_status", .fc_group = 'C', .ll_group = 'D', .number = 0x1C, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_diag_get_lb_status(ioc); }},
        {.name = "hxal_diag_fwping", .fc_group = 'C', .ll_group = 'D', .number = 0x15, .size = 56,
         .call = [](hxal_t* ioc, void* out)
         { return hxal_diag_fwping(ioc, 0x01020304, 0x0A0B0C0D, static_cast<hxa_diag_fwping_result_t*>(out)); },
         .sent = {{8, {4, 3, 2, 1, 0x0D, 0x0C, 0x0B, 0x0A}}}, .copied = {{16, 40}}, .optional_output = true},
        {.name = "hxal_diag_queuetest", .fc_group = 'C', .ll_group = 'D', .number = 0x16, .size = 24,
         .call = [](hxal_t* ioc, void* out)
         { return hxal_diag_queuetest(ioc, 0x01020304, static_cast<hxa_diag_qtest_result_t*>(out)); },
         .sent = {{12, {4, 3, 2, 1}}}, .copied = {{16, 8}}, .optional_output = true},
        {.name = "hxal_diag_sfp_query", .fc_group = 'C', .ll_group = 'D', .number = 0x18, .size = 224,
         .call = [](hxal_t* ioc, void* out) { return hxal_diag_sfp_query(ioc, static_cast<sfp_mem_t*>(out)); },
         .copied = {{8, 216}}, .optional_output = true},
        {.name = "hxal_diag_led_test", .fc_group = 'C', .ll_group = 'D', .number = 0x19, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_diag_led_test(ioc, &lights); },
         .sent = {{8, bytes_of(lights)}}},
        {.name = "hxal_diag_beacon_swport", .fc_group = 'C', .ll_group = 'D', .number = 0x1A, .size = 20,
         .call = [](hxal_t* ioc, void*) { return hxal_diag_beacon_swport(ioc, HXA_TRUE, 0x01020304); },
         .sent = {{8, {1, 0, 0, 0, 1, 0, 0, 0, 4, 3, 2, 1}}}},
        {.name = "hxal_sfp_media", .fc_group = 'C', .ll_group = 'D', .number = 0x3F, .size = 12,
         .call = [](hxal_t* ioc, void* out) { return hxal_sfp_media(ioc, static_cast<hxa_defs_sfp_media_t*>(out)); },
         .copied = {{8, 4}}, .optional_output = true},
        {.name = "hxal_sfp_speed", .fc_group = 'C', .ll_group = 'D', .number = 0x40, .size = 12,
         .call = [](hxal_t* ioc, void*) { return hxal_sfp_speed(ioc, 0x01020304); },
         .sent = {{8, {4, 3, 2, 1}}}},
    };
    // clang-format on
    return operations;
}
