// What SCSI answers hold (SPC-3): standard INQUIRY data, the vital product data pages 80h and 83h, REPORT LUNS. Pure functions
// over the bytes of an answer; lengths in it are never trusted beyond the buffer.
#pragma once

#include "hxal/records/types.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>

namespace zmlr
{

// Sizes of the data that are asked for, in bytes.
constexpr std::size_t inquiry_size = 36;
constexpr std::size_t identification_page_size = 40; // 83h
constexpr std::size_t serial_page_size = 36;         // 80h

using Inquiry_Data = std::array<std::uint8_t, inquiry_size>;
using Identification_Page = std::array<std::uint8_t, identification_page_size>;
using Serial_Page = std::array<std::uint8_t, serial_page_size>;

// Where a unit's identifier comes from: the types of designators in page 83h that are used, and what stands for them.
enum Identifier_Type : std::uint32_t
{
    IDENTIFIER_SERIAL_NUMBER = 0, // page 80h
    IDENTIFIER_T10_VENDOR_ID = 1,
    IDENTIFIER_EUI_64 = 2,
    IDENTIFIER_NAA = 3,
    IDENTIFIER_SCSI_NAME = 8,
    IDENTIFIER_UNAVAILABLE = 10 // page 80h failed
};

// _hbaLunInfo: one logical unit. Texts are zero-terminated, and as the unit delivered them.
struct _hbaLunInfo
{
    std::array<std::uint8_t, sizeof(lun_t)> lun = {}; // as REPORT LUNS gave it
    char target_wwn[36] = {};
    char vendor[9] = {};
    char product[17] = {};
    char rsvd[5] = {};
    char serial_number[130] = {};
    char identifier[67] = {}; // of page 83h: hex digits or text
    std::uint32_t identifier_type = IDENTIFIER_SERIAL_NUMBER;
};
static_assert(sizeof(_hbaLunInfo) == 276);

// True for a peripheral device that is a tape drive or a medium changer; all others count as disks.
bool is_tape_device(const Inquiry_Data& data);

void fill_inquiry(_hbaLunInfo& info, const Inquiry_Data& data);

// Takes identifier and type from the first designator of page 83h; false when it is of a type that is not used.
bool fill_identifier(_hbaLunInfo& info, const Identification_Page& page);

void fill_serial_number(_hbaLunInfo& info, const Serial_Page& page);

// Answers of REPORT LUNS: a head with the length of the list, then an entry a unit.
constexpr std::size_t lun_list_head = 8;
constexpr std::size_t lun_entry_size = sizeof(lun_t);

using Lun_Entry = std::span<const std::uint8_t, lun_entry_size>;

// In peripheral and flat addressing (SAM-3).
constexpr std::uint32_t lun_number(Lun_Entry entry) { return (entry[0] & 0x3FU) * 256 + entry[1]; }

// How many units the list says there are, and how many entries a buffer has room for.
std::uint32_t lun_count(std::span<const std::uint8_t> list);
constexpr std::size_t lun_room(std::size_t list_size) { return (list_size - lun_list_head) / lun_entry_size; }

} // namespace zmlr
