#include "sim/commands/scsi_execution.h"

#include "sim/commands/scsi_inquiry.h"
#include "sim/commands/scsi_lun.h"

#include <algorithm>
#include <cstring>
#include <limits>

namespace hxasim
{

namespace
{

constexpr std::uint8_t check_condition = 0x02;

// Why a command is not carried out: sense key, additional sense code and its qualifier, SPC-3.
struct Sense
{
    std::uint8_t key;
    std::uint8_t code;
    std::uint8_t qualifier;
};

constexpr Sense not_ready{0x02, 0x04, 0x00};
constexpr Sense medium_not_present{0x02, 0x3A, 0x00};
constexpr Sense invalid_operation_code{0x05, 0x20, 0x00};
constexpr Sense invalid_field_in_cdb{0x05, 0x24, 0x00};
constexpr Sense unit_not_supported{0x05, 0x25, 0x00};

Scsi_Answer refuse_with(const Sense& sense)
{
    constexpr std::size_t sense_size = 18;
    Scsi_Answer answer{.status = check_condition, .sense = std::vector<std::uint8_t>(sense_size)};
    answer.sense[0] = 0x70; // current error, fixed format
    answer.sense[2] = sense.key;
    answer.sense[7] = sense_size - 8;
    answer.sense[12] = sense.code;
    answer.sense[13] = sense.qualifier;
    return answer;
}

// Data go out up to the allocation length of the command.
Scsi_Answer deliver(std::vector<std::uint8_t> data, std::uint64_t allocated)
{
    data.resize(static_cast<std::size_t>(std::min<std::uint64_t>(data.size(), allocated)));
    return {.data = std::move(data)};
}

std::uint64_t number_at(const std::uint8_t* field, std::size_t size)
{
    std::uint64_t value = 0;
    for (std::size_t i = 0; i < size; ++i)
        value = value << 8 | field[i];
    return value;
}

void append_number(std::vector<std::uint8_t>& bytes, std::uint64_t value, unsigned size)
{
    for (unsigned left = size; left > 0; --left)
        bytes.push_back(static_cast<std::uint8_t>(value >> 8 * (left - 1)));
}

const Unit_Range* find(const Scsi_Target& target, std::optional<std::uint32_t> number)
{
    auto holds = [=](const Unit_Range& range) { return number && *number >= range.first && *number - range.first < range.count; };
    auto found = std::find_if(target.units.begin(), target.units.end(), holds);
    return found == target.units.end() ? nullptr : &*found;
}

bool has_blocks(const Unit_Range& range) { return range.type == disk || range.type == cdrom; }

Scsi_Answer inquire(const Scsi_Target& target, const Unit_Range* range, std::uint32_t number, const std::uint8_t* cdb)
{
    const bool vital = (cdb[1] & 1) != 0;
    const auto page = cdb[2];
    const auto allocated = number_at(cdb + 3, 2);
    if (!vital)
        return page == 0 ? deliver(standard_inquiry(range), allocated) : refuse_with(invalid_field_in_cdb);
    if (!range)
        return refuse_with(unit_not_supported);
    auto data = vital_product_data(target, *range, number, page);
    return data ? deliver(std::move(*data), allocated) : refuse_with(invalid_field_in_cdb);
}

Scsi_Answer report_luns(const Scsi_Target& target, const std::uint8_t* cdb)
{
    enum Selected : std::uint8_t
    {
        addressable = 0,
        well_known = 1,
        all = 2
    };
    const auto selected = cdb[2];
    if (selected > all)
        return refuse_with(invalid_field_in_cdb);
    if (!target.report_luns.empty())
        return deliver(target.report_luns, number_at(cdb + 6, 4));
    std::vector<std::uint8_t> list;
    if (selected != well_known)
        for (const auto& range : target.units)
            for (std::uint32_t i = 0; i < range.count; ++i)
            {
                const auto lun = lun_of(range.first + i, target.flat);
                list.insert(list.end(), lun.begin(), lun.end());
            }
    std::vector<std::uint8_t> data;
    data.reserve(8 + list.size());
    append_number(data, list.size(), 4);
    append_number(data, 0, 4);
    data.insert(data.end(), list.begin(), list.end());
    return deliver(std::move(data), number_at(cdb + 6, 4));
}

Scsi_Answer read_capacity_10(const Unit_Range& range)
{
    constexpr std::uint64_t beyond = std::numeric_limits<std::uint32_t>::max(); // ask with READ CAPACITY (16)
    std::vector<std::uint8_t> data;
    append_number(data, std::min(range.blocks - 1, beyond), 4);
    append_number(data, range.block_size, 4);
    return {.data = std::move(data)};
}

Scsi_Answer read_capacity_16(const Unit_Range& range, const std::uint8_t* cdb)
{
    constexpr std::size_t size = 32;
    std::vector<std::uint8_t> data;
    append_number(data, range.blocks - 1, 8);
    append_number(data, range.block_size, 4);
    data.resize(size);
    return deliver(std::move(data), number_at(cdb + 10, 4));
}

Scsi_Answer read_capacity(const Unit_Range& range, const std::uint8_t* cdb)
{
    constexpr std::uint8_t capacity_16_action = 0x10;
    const bool is_16 = cdb[0] == 0x9E;
    if (!has_blocks(range))
        return refuse_with(invalid_operation_code);
    if (is_16 && (cdb[1] & 0x1F) != capacity_16_action)
        return refuse_with(invalid_field_in_cdb);
    return is_16 ? read_capacity_16(range, cdb) : read_capacity_10(range);
}

// Commands that need the medium.
Scsi_Answer use_medium(const Unit_Range& range, const std::uint8_t* cdb)
{
    if (range.state == Unit_State::not_ready)
        return refuse_with(not_ready);
    if (range.state == Unit_State::no_medium)
        return refuse_with(medium_not_present);
    const bool is_test = cdb[0] == 0x00;
    return is_test ? Scsi_Answer() : read_capacity(range, cdb);
}

} // namespace

Scsi_Answer execute(const Scsi_Target& target, lun_t lun, const scsi_cdb_t& command)
{
    Lun_Bytes bytes;
    std::memcpy(bytes.data(), &lun, sizeof(lun));
    const auto number = unit_number(bytes);
    const auto* range = find(target, number);
    const auto* cdb = command.scsi_cdb;
    switch (cdb[0])
    {
    case 0x12: // INQUIRY
        return inquire(target, range, number.value_or(0), cdb);
    case 0xA0: // REPORT LUNS, which LUN 0 answers also where there is no such unit
        return range || number == 0U ? report_luns(target, cdb) : refuse_with(unit_not_supported);
    case 0x00: // TEST UNIT READY
    case 0x25: // READ CAPACITY (10)
    case 0x9E: // SERVICE ACTION IN (16)
        return range ? use_medium(*range, cdb) : refuse_with(unit_not_supported);
    default:
        return refuse_with(range ? invalid_operation_code : unit_not_supported);
    }
}

} // namespace hxasim
