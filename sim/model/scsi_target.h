// The logical units behind a simulated SCSI target.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

namespace hxasim
{

// Peripheral device types, SPC-3.
enum Device_Type : std::uint8_t
{
    disk = 0x00,
    tape = 0x01,
    processor = 0x03,
    cdrom = 0x05,
    changer = 0x08,
    array_controller = 0x0C,
    enclosure = 0x0D,
    no_device = 0x1F,
};

enum class Unit_State : std::uint32_t
{
    ready,
    not_ready,
    no_medium
};

// What the first descriptor of the Device Identification page holds.
enum class Identification : std::uint32_t
{
    naa,
    eui64,
    t10,
    name,
    none // there is no such page
};

// Logical units that are alike but for their numbers.
struct Unit_Range
{
    std::uint32_t first = 0; // LUN
    std::uint32_t count = 1;
    std::uint8_t type = disk;
    std::string vendor;
    std::string product;
    std::string revision;
    std::string serial;      // of a single unit; the LUN is added where there are several
    bool serial_page = true; // there is a Unit Serial Number page
    std::uint32_t block_size = 512;
    std::uint64_t blocks = 0;
    Unit_State state = Unit_State::ready;
    Identification identification = Identification::naa;
    std::vector<std::uint8_t> descriptors; // instead
    std::vector<std::uint8_t> inquiry;     // instead of the standard INQUIRY data
    std::vector<std::uint8_t> page_80;     // instead of the whole page, as the next one
    std::vector<std::uint8_t> page_83;
};

constexpr std::uint32_t max_units = 65536;

struct Scsi_Target
{
    std::array<std::uint8_t, 8> name{}; // node WWN, the same through all ports of a device
    bool flat = false;                  // every LUN in flat addressing; else those from 256 on
    std::vector<Unit_Range> units;
    std::vector<std::uint8_t> report_luns; // instead of the list of its units
};

} // namespace hxasim
