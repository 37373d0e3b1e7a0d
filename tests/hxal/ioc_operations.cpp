#include "operation_table.h"

namespace
{

const std::string longest_name(64, 'n');

// Interrupt moderation in the order of the record: on, latency 0x0201, delay 0x0403.
const std::vector<std::uint8_t> moderation = {1, 0, 0, 0, 1, 2, 3, 4};

} // namespace

const std::vector<Operation>& ioc_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_ioc_get_info", .fc_group = 'C', .ll_group = 'D', .number = 0x07, .size = 520,
         .call = [](hxal_t* ioc, void* out) { return hxal_ioc_get_info(ioc, static_cast<hxa_ioctl_ioc_info_t*>(out)); },
         .copied = {{0, 520}}, .in_place = true},
        {.name = "hxal_ioc_get_attr", .fc_group = 'C', .ll_group = 'D', .number = 0x06, .size = 1608,
         .call = [](hxal_t* ioc, void* out) { return hxal_ioc_get_attr(ioc, static_cast<hxa_ioc_attr_t*>(out)); },
         .copied = {{8, 1600}}, .printed_on_error = "IOCTL ERR  IOCMD_IOC_GET_ATTR   No such device or address\n"},
        {.name = "hxal_ioc_get_stats", .fc_group = 'C', .ll_group = 'D', .number = 0x08, .size = 84,
         .call = [](hxal_t* ioc, void* out) { return hxal_ioc_get_stats(ioc, static_cast<hxa_ioc_stats_t*>(out)); },
         .copied = {{8, 76}}},
        {.name = "hxal_ioc_reset_stats", .fc_group = 'C', .ll_group = 'D', .number = 0x09, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_ioc_reset_stats(ioc); }},
        {.name = "hxal_ioc_set_power", .fc_group = 'C', .ll_group = 'D', .number = 0x0A, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_ioc_set_power(ioc, HXA_PM_DS_D2); },
         .sent = {{8, {2}}}},
        {.name = "hxal_ioc_set_name", .fc_group = 'C', .ll_group = 'D', .number = 0x0D, .size = 72,
         .call = [](hxal_t* ioc, void*) { return hxal_ioc_set_name(ioc, "green"); },
         .sent = {{8, bytes_of("green")}},
         .fc_recorded = {"hxa1-port-name = \"green\";"}, .ll_recorded = {"hxn1-port-name = \"green\";"}},
        {.name = "hxal_ioc_set_name of 65 characters", .fc_group = 'C', .ll_group = 'D', .number = 0x0D, .size = 72,
         .call = [](hxal_t* ioc, void*) { return hxal_ioc_set_name(ioc, (longest_name + "x").c_str()); },
         .sent = {{8, bytes_of(longest_name.c_str())}},
         .fc_recorded = {"hxa1-port-name = \"" + longest_name + "x\";"},
         .ll_recorded = {"hxn1-port-name = \"" + longest_name + "x\";"}},
        {.name = "hxal_ioc_intr_set", .fc_group = 0xB0, .ll_group = 'D', .number = 0x04, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_ioc_intr_set(ioc, HXA_TRUE, 0x0403, 0x0201); },
         .sent = {{8, moderation}}, .fc_recorded = {"hxa1-delay = 1027;", "hxa1-latency = 513;"}},
        {.name = "hxal_iocfc_intr_set", .fc_group = 0xB0, .ll_group = 0, .number = 0x04, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_iocfc_intr_set(ioc, HXA_TRUE, 0x0403, 0x0201); },
         .sent = {{8, moderation}}, .fc_recorded = {"hxa1-delay = 1027;", "hxa1-latency = 513;"}},
        {.name = "hxal_iocfc_get_attr", .fc_group = 0xB0, .ll_group = 0, .number = 0x01, .size = 64,
         .call = [](hxal_t* ioc, void* out) { return hxal_iocfc_get_attr(ioc, static_cast<hxa_iocfc_attr_t*>(out)); },
         .copied = {{8, 56}}, .printed_on_refusal = "Not an FC IOC\n"},
        {.name = "hxal_iocfc_get_stats", .fc_group = 0xB0, .ll_group = 0, .number = 0x02, .size = 472,
         .call = [](hxal_t* ioc, void* out) { return hxal_iocfc_get_stats(ioc, static_cast<hxa_iocfc_stats_t*>(out)); },
         .copied = {{8, 464}}},
        {.name = "hxal_iocfc_reset_stats", .fc_group = 0xB0, .ll_group = 0, .number = 0x03, .size = 8,
         .call = [](hxal_t* ioc, void*) { return hxal_iocfc_reset_stats(ioc); }},
    };
    // clang-format on
    return operations;
}
