#include "operation_table.h"

namespace
{

hxa_status_t write_manufacturing_block(hxal_t* ioc)
{
    return hxal_flash_mfg_info(ioc, "SERIAL-NUMBER", "PART-NUMBER-TOO-LONG", 0x0807060504030201, {{1, 2, 3, 4, 5, 6}}, 86);
}

} // namespace

const std::vector<Operation>& flash_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_flash_get_attr", .fc_group = 0xB5, .ll_group = 0xB5, .number = 0x01, .size = 528,
         .call = [](hxal_t* ioc, void* out) { return hxal_flash_get_attr(ioc, static_cast<hxa_flash_attr_t*>(out)); },
         .copied = {{8, 520}}},
        {.name = "hxal_flash_erase_part", .fc_group = 0xB5, .ll_group = 0xB5, .number = 0x02, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_flash_erase_part(ioc, HXA_FLASH_PART_FWCFG, 1); },
         .sent = {{6, {1}}, {16, {3}}}},
        {.name = "hxal_flash_mfg_info", .fc_group = 0xB5, .ll_group = 0xB5, .number = 0x05, .size = 264,
         .call = [](hxal_t* ioc, void*) { return write_manufacturing_block(ioc); },
         .sent = {{12, {0, 1}}, {16, bytes_of("SERIAL-NUMB")}, {28, bytes_of("PART-NUMBER-TO")}, {48, {1, 2, 3, 4, 5, 6, 7, 8}},
                  {128, {1, 2, 3, 4, 5, 6}}, {136, {86}}}},
        {.name = "hxal_flash_enable_optrom", .fc_group = 0xB5, .ll_group = 0xB5, .number = 0x06, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_flash_enable_optrom(ioc); }},
        {.name = "hxal_flash_disable_optrom", .fc_group = 0xB5, .ll_group = 0xB5, .number = 0x07, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_flash_disable_optrom(ioc); }},
    };
    // clang-format on
    return operations;
}
