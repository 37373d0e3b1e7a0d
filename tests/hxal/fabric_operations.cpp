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

constexpr lun_t lun = 0x0000000000000540; // flat addressing, 5
constexpr std::uint32_t length = 0x0102032C;

// What a SCSI helper puts into a command that says 0xC0 in bytes 2, 9 and 15 so far.
struct Scsi_Helper
{
    const char* name;
    decltype(&hxal_scsi_inquiry) function;
    std::vector<std::uint8_t> cdb;
};

// clang-format off
const Scsi_Helper scsi_helpers[] = {
    {"hxal_scsi_inquiry",        hxal_scsi_inquiry,        {0x12, 0, 0xC0, 0, 0x2C, 0, 0, 0, 0, 0xC0, 0, 0, 0, 0, 0, 0xC0}},
    {"hxal_scsi_readcapacity",   hxal_scsi_readcapacity,   {0x25, 0, 0xC0, 0, 0, 0, 0, 0, 0, 0xC0, 0, 0, 0, 0, 0, 0xC0}},
    {"hxal_scsi_readcapacity16", hxal_scsi_readcapacity16, {0x9E, 0x10, 0xC0, 0, 0, 0, 0, 0, 0, 0xC0, 1, 2, 3, 0x2C, 0, 0xC0}},
    {"hxal_scsi_reportluns",     hxal_scsi_reportluns,     {0xA0, 0, 0xC0, 0, 0, 0, 1, 2, 3, 0x2C, 0, 0, 0, 0, 0, 0xC0}},
    {"hxal_scsi_testunitready",  hxal_scsi_testunitready,  {0x00, 0, 0xC0, 0, 0, 0, 0, 0, 0, 0xC0, 0, 0, 0, 0, 0, 0xC0}},
};
// clang-format on

uint8_t* status_in(void* output) { return output ? static_cast<uint8_t*>(output) + 4 : nullptr; }
scsi_cdb_t command_so_far() { return {{0, 0, 0xC0, 0, 0, 0, 0, 0, 0, 0xC0, 0, 0, 0, 0, 0, 0xC0}}; }

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

// The harness's buffer gives the room for the sense data and takes their length, then the SCSI status.
const std::vector<Operation>& scsi_operations()
{
    static const auto operations = []
    {
        std::vector<Operation> rows;
        const std::vector<Sent> common = {nexus, {24, bytes_of(lun)}, {52, bytes_of(length)}, {64, address_of(request)}};
        const auto add = [&](const char* name, std::vector<std::uint8_t> cdb, std::vector<std::uint8_t> write, auto send)
        {
            auto sent = common;
            sent.insert(sent.end(), {{32, std::move(cdb)}, {48, std::move(write)}});
            sent.insert(sent.end(), {{60, room}, {72, address_of(response)}});
            rows.push_back({.name = name,
                            .fc_group = 0xBA,
                            .ll_group = 0xBA,
                            .number = 0x01,
                            .size = 80,
                            .call = send,
                            .sent = std::move(sent),
                            .copied = {{60, 4}, {59, 1, 4}},
                            .optional_output = true});
        };
        static const scsi_cdb_t any_command = {{1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16}};
        add("hxal_scsi_cmnd", bytes_of(any_command), {1},
            [](hxal_t* ioc, void* out)
            {
                return hxal_scsi_cmnd(ioc, vf, logical, remote, lun, &any_command, 1, request, length, status_in(out), response,
                                      static_cast<uint32_t*>(out));
            });
        for (const auto& helper : scsi_helpers)
            add(helper.name, helper.cdb, {},
                [&helper](hxal_t* ioc, void* out)
                {
                    scsi_cdb_t cdb = command_so_far();
                    return helper.function(ioc, vf, logical, remote, lun, &cdb, 1, request, length, status_in(out), response,
                                           static_cast<uint32_t*>(out));
                });
        return rows;
    }();
    return operations;
}
