// The command catalogue: every request the drivers know, one row each (C++ only; the library and the simulator read it).
//
// A command number is the Linux read/write request code: direction 3 in bits 31..30, record size in bits 29..16, group
// byte in bits 15..8, number within the group in bits 7..0.
#pragma once

#include "hxal/records/aen.h"
#include "hxal/records/ioc.h"
#include "hxal/records/port.h"

#include <array>
#include <cstdint>
#include <string_view>

namespace hxal
{

// The group byte of a command family, by the type of the IOC it is sent to.
struct Family
{
    std::uint8_t fc; // FC and FCoE IOCs
    std::uint8_t ll; // Ethernet IOCs
};

inline constexpr Family common_family{.fc = 'C', .ll = 'D'};

// Its address stands for the record type in a row of the catalogue.
template <typename Record> inline constexpr char record_tag = 0;

struct Command
{
    std::string_view name;
    Family family;
    std::uint8_t number;
    std::uint32_t size; // of the record, in bytes
    const char* record; // tag of the record type
};

template <typename Record> consteval Command command(std::string_view name, Family family, std::uint8_t number)
{
    return {.name = name, .family = family, .number = number, .size = sizeof(Record), .record = &record_tag<Record>};
}

// clang-format off
inline constexpr std::array catalogue{
    //      record                       name                     family         number
    command<hxa_ioctl_ioc_get_version_t>("IOCMD_IOC_GET_VERSION", common_family, 0x01),
    command<hxa_ioctl_ioc_get_inst_t>   ("IOCMD_IOC_GET_INST",    common_family, 0x02),
    command<hxa_ioctl_ioc_attr_t>       ("IOCMD_IOC_GET_ATTR",    common_family, 0x06),
    command<hxa_ioctl_ioc_info_t>       ("IOCMD_IOC_GET_INFO",    common_family, 0x07),
    command<hxa_ioctl_aen_t>            ("IOCMD_AEN_SYNC",        common_family, 0x2A),
    command<hxa_ioctl_port_attr_t>      ("IOCMD_PORT_GET_ATTR",   common_family, 0x2D),
};
// clang-format on

// The command number under a group byte.
constexpr std::uint32_t command_code(const Command& command, std::uint8_t group)
{
    return std::uint32_t{3} << 30 | command.size << 16 | std::uint32_t{group} << 8 | command.number;
}

} // namespace hxal
