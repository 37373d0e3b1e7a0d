#include "sim/commands/scsi_inquiry.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <string_view>

namespace hxasim
{

namespace
{

using Bytes = std::vector<std::uint8_t>;

constexpr std::uint8_t supported_pages = 0x00;
constexpr std::uint8_t unit_serial_number = 0x80;
constexpr std::uint8_t device_identification = 0x83;

// Of an identification descriptor.
constexpr std::uint8_t binary = 1;
constexpr std::uint8_t ascii = 2;
constexpr std::uint8_t utf8 = 3;

void append(Bytes& bytes, std::string_view text, std::size_t size)
{
    for (std::size_t i = 0; i < size; ++i)
        bytes.push_back(i < text.size() ? static_cast<std::uint8_t>(text[i]) : std::uint8_t{' '});
}

std::string hexadecimal(const Bytes& bytes)
{
    std::string digits;
    for (unsigned byte : bytes)
    {
        digits += "0123456789ABCDEF"[byte >> 4];
        digits += "0123456789ABCDEF"[byte & 15];
    }
    return digits;
}

std::string serial_number(const Scsi_Target& target, const Unit_Range& unit, std::uint32_t number)
{
    std::array<char, 16> own{};
    if (unit.serial.empty())
    {
        std::snprintf(own.data(), own.size(), "%02X%02X%02X%05u", target.name[5], target.name[6], target.name[7], number);
        return own.data();
    }
    if (unit.count == 1)
        return unit.serial;
    std::snprintf(own.data(), own.size(), "%05u", number);
    return unit.serial + own.data();
}

// Registered extended, 16 bytes: the device's name with its first two bytes replaced, and the number.
Bytes naa(const Scsi_Target& target, std::uint32_t number)
{
    Bytes id{0x60, 0x00};
    id.insert(id.end(), target.name.begin() + 2, target.name.end());
    id.insert(id.end(), {0, 0, 0, 0, 0});
    for (int shift : {16, 8, 0})
        id.push_back(static_cast<std::uint8_t>(number >> shift));
    return id;
}

Bytes eui64(const Scsi_Target& target, std::uint32_t number)
{
    Bytes id(target.name.begin() + 2, target.name.end());
    id.push_back(static_cast<std::uint8_t>(number >> 8));
    id.push_back(static_cast<std::uint8_t>(number));
    return id;
}

// Two bytes that say what follows, its length, and what follows.
Bytes with_head(std::uint8_t first, std::uint8_t second, const Bytes& contents)
{
    const std::array head{first, second, static_cast<std::uint8_t>(contents.size() >> 8),
                          static_cast<std::uint8_t>(contents.size())};
    Bytes bytes(head.size() + contents.size());
    std::ranges::copy(contents, std::ranges::copy(head, bytes.begin()).out);
    return bytes;
}

Bytes descriptor(std::uint8_t code_set, std::uint8_t type, const Bytes& id) { return with_head(code_set, type, id); }

Bytes text_bytes(std::string_view text) { return {text.begin(), text.end()}; }

Bytes identification(const Scsi_Target& target, const Unit_Range& unit, std::uint32_t number)
{
    if (!unit.descriptors.empty())
        return unit.descriptors;
    switch (unit.identification)
    {
    case Identification::eui64:
        return descriptor(binary, 2, eui64(target, number));
    case Identification::t10:
    {
        Bytes id;
        append(id, unit.vendor, 8);
        const auto serial = serial_number(target, unit, number);
        append(id, serial, serial.size());
        return descriptor(ascii, 1, id);
    }
    case Identification::name:
        return descriptor(utf8, 8, text_bytes("eui." + hexadecimal(eui64(target, number))));
    default:
        return descriptor(binary, 3, naa(target, number));
    }
}

bool has_serial(const Unit_Range& unit) { return unit.serial_page || !unit.page_80.empty(); }

bool has_identification(const Unit_Range& unit)
{
    return !unit.page_83.empty() || unit.identification != Identification::none || !unit.descriptors.empty();
}

Bytes page_list(const Unit_Range& unit)
{
    Bytes pages{supported_pages};
    if (has_serial(unit))
        pages.push_back(unit_serial_number);
    if (has_identification(unit))
        pages.push_back(device_identification);
    return pages;
}

} // namespace

Bytes standard_inquiry(const Unit_Range* unit)
{
    constexpr std::uint8_t not_capable = 0x60; // peripheral qualifier: no unit can be here
    constexpr std::uint8_t removable = 0x80;
    constexpr std::uint8_t hierarchical = 0x10; // LUNs as REPORT LUNS has them
    if (unit && !unit->inquiry.empty())
        return unit->inquiry;
    const bool has_media = unit && (unit->type == tape || unit->type == cdrom);
    Bytes data{unit ? unit->type : static_cast<std::uint8_t>(not_capable | no_device),
               has_media ? removable : std::uint8_t{0},
               5, // SPC-3
               hierarchical | 2,
               31, // bytes that follow
               0,
               0,
               2}; // command queues
    append(data, unit ? unit->vendor : "", 8);
    append(data, unit ? unit->product : "", 16);
    append(data, unit ? unit->revision : "", 4);
    return data;
}

std::optional<Bytes> vital_product_data(const Scsi_Target& target, const Unit_Range& unit, std::uint32_t number,
                                        std::uint8_t page)
{
    if (page == supported_pages)
        return with_head(unit.type, page, page_list(unit));
    if (page == unit_serial_number && !unit.page_80.empty())
        return unit.page_80;
    if (page == device_identification && !unit.page_83.empty())
        return unit.page_83;
    if (page == unit_serial_number && unit.serial_page)
        return with_head(unit.type, page, text_bytes(serial_number(target, unit, number)));
    if (page == device_identification && has_identification(unit))
        return with_head(unit.type, page, identification(target, unit, number));
    return std::nullopt;
}

} // namespace hxasim
