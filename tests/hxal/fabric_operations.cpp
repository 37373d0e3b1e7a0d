#include "operation_table.h"

#include <cstring>

namespace
{

constexpr std::uint16_t vf = 0x0201;
constexpr wwn_t logical = 0x1716151413121110;
constexpr wwn_t remote = 0x2726252423222120;

// The virtual fabric, the logical port and the remote port as they stand in a record.
const Sent lport = {6, {0x01, 0x02, 0x10, 0x11, 0x12, 0x13, 0x14, 0x15, 0x16, 0x17}};
const Sent nexus = {6,
                    {0x01, 0x02, 0x10, 0x11, 0x12, 0x13, 0x14, 0x15, 0x16, 0x17, 0x20, 0x21, 0x22, 0x23, 0x24, 0x25, 0x26, 0x27}};

// What requests refer to. A size that goes out is the one that stands in the harness's buffer before the call.
const std::vector<std::uint8_t> room = {0xEE, 0xEE, 0xEE, 0xEE};
wwn_t wwns[4];
std::uint8_t request[3];
std::uint8_t response[16];

fchs_t frame_header()
{
    fchs_t header{};
    for (std::uint8_t at = 0; at < sizeof header; ++at)
        reinterpret_cast<std::uint8_t*>(&header)[at] = static_cast<std::uint8_t>(0x40 + at);
    return header;
}

template <typename Pointer> std::vector<std::uint8_t> address_of(Pointer pointer)
{
    return bytes_of(static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(pointer)));
}

} // namespace

const std::vector<Operation>& lport_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_lport_get_attr", .fc_group = 0xB1, .ll_group = 0xB1, .number = 0x01, .size = 232,
         .call = [](hxal_t* ioc, void* out) { return hxal_lport_get_attr(ioc, vf, logical, static_cast<hxa_port_attr_t*>(out)); },
         .sent = {lport}, .copied = {{16, 216}}},
        {.name = "hxal_lport_reset_stats", .fc_group = 0xB1, .ll_group = 0xB1, .number = 0x03, .size = 16,
         .call = [](hxal_t* ioc, void*) { return hxal_lport_reset_stats(ioc, vf, logical); },
         .sent = {lport}},
        {.name = "hxal_lport_get_rports", .fc_group = 0xB1, .ll_group = 0xB1, .number = 0x04, .size = 32,
         .call = [](hxal_t* ioc, void* out) { return hxal_lport_get_rports(ioc, vf, logical, wwns, static_cast<uint32_t*>(out)); },
         .sent = {lport, {16, address_of(wwns)}, {24, room}}, .copied = {{24, 4}}},
    };
    // clang-format on
    return operations;
}

const std::vector<Operation>& rport_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_rport_add", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x01, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_rport_add(ioc, vf, logical, remote); },
         .sent = {nexus}},
        {.name = "hxal_rport_remove", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x02, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_rport_remove(ioc, vf, logical, remote); },
         .sent = {nexus}},
        {.name = "hxal_rport_get_stats", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x03, .size = 288,
         .call = [](hxal_t* ioc, void* out)
         { return hxal_rport_get_stats(ioc, vf, logical, remote, static_cast<hxa_rport_stats_t*>(out)); },
         .sent = {nexus}, .copied = {{24, 264}}},
        {.name = "hxal_rport_reset_stats", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x04, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_rport_reset_stats(ioc, vf, logical, remote); },
         .sent = {nexus}},
        {.name = "hxal_rport_get_attr", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x05, .size = 344,
         .call = [](hxal_t* ioc, void* out)
         { return hxal_rport_get_attr(ioc, vf, logical, remote, static_cast<hxa_rport_attr_t*>(out)); },
         .sent = {nexus}, .copied = {{24, 320}}},
        {.name = "hxal_rport_get_scsi_address", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x06, .size = 40,
         .call = [](hxal_t* ioc, void* out)
         {
             auto* numbers = static_cast<uint32_t*>(out);
             return hxal_rport_get_scsi_address(ioc, vf, logical, remote, numbers, out ? numbers + 1 : nullptr,
                                                out ? numbers + 2 : nullptr);
         },
         .sent = {nexus}, .copied = {{24, 12}}},
        {.name = "hxal_rport_set_speed", .fc_group = 0xB2, .ll_group = 0xB2, .number = 0x07, .size = 32,
         .call = [](hxal_t* ioc, void*) { return hxal_rport_set_speed(ioc, vf, logical, remote, HXA_PPORT_SPEED_4GBPS); },
         .sent = {{6, {0x01, 0x02, 4}}, {16, bytes_of(logical)}, {24, bytes_of(remote)}}},
    };
    // clang-format on
    return operations;
}

const std::vector<Operation>& itnim_operations()
{
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_itnim_get_stats", .fc_group = 0xBB, .ll_group = 0xBB, .number = 0x02, .size = 168,
         .call = [](hxal_t* ioc, void* out)
         { return hxal_itnim_get_stats(ioc, vf, logical, remote, static_cast<hxa_itnim_stats_t*>(out)); },
         .sent = {nexus}, .copied = {{24, 144}}},
        {.name = "hxal_itnim_reset_stats", .fc_group = 0xBB, .ll_group = 0xBB, .number = 0x03, .size = 24,
         .call = [](hxal_t* ioc, void*) { return hxal_itnim_reset_stats(ioc, vf, logical, remote); },
         .sent = {nexus}},
    };
    // clang-format on
    return operations;
}

const std::vector<Operation>& fcpt_operations()
{
    static const fchs_t header = frame_header();
    // clang-format off
    static const std::vector<Operation> operations = {
        {.name = "hxal_fcpt", .fc_group = 0xBA, .ll_group = 0xBA, .number = 0x02, .size = 96,
         .call = [](hxal_t* ioc, void* out)
         {
             return hxal_fcpt(ioc, vf, logical, remote, 0x0A0B, HXA_TRUE, FC_CLASS_2, &header, request, sizeof request, response,
                              static_cast<uint32_t*>(out));
         },
         .sent = {nexus, {24, {0x0B, 0x0A, 0, 0, 1, 0, 0, 0, 4}}, {40, bytes_of(header)},
                  {64, {1, 0, 0, 0, 3}}, {72, room}, {80, address_of(request)}, {88, address_of(response)}},
         .copied = {{72, 4}}},
        {.name = "hxal_fcpt without destination and request", .fc_group = 0xBA, .ll_group = 0xBA, .number = 0x02, .size = 96,
         .call = [](hxal_t* ioc, void* out)
         {
             return hxal_fcpt(ioc, vf, logical, 0, 0, HXA_FALSE, FC_CLASS_3, &header, nullptr, 0, response,
                              static_cast<uint32_t*>(out));
         },
         .sent = {lport, {32, {8}}, {40, bytes_of(header)}, {72, room}, {88, address_of(response)}}, .copied = {{72, 4}}},
    };
    // clang-format on
    return operations;
}
