// Reading what a scenario says of the logical units behind a remote port.
#include "sim/scenario/port_scenario.h"
#include "sim/scenario/scenario_words.h"

#include <bitset>

namespace hxasim
{

namespace
{

constexpr std::size_t max_ranges = 1024;
constexpr std::uint32_t max_capacity = 1U << 31; // MiB
constexpr std::uint64_t MiB = 1024 * 1024;

const char* usual_product(std::uint8_t type)
{
    switch (type)
    {
    case disk:
        return "VIRTUAL DISK";
    case tape:
        return "VIRTUAL TAPE";
    case changer:
        return "VIRTUAL CHANGER";
    default:
        return "VIRTUAL DEVICE";
    }
}

Unit_Range read_range(Json_Object& object, std::uint32_t first)
{
    Unit_Range range;
    range.first = object.number("lun", max_units - 1, first);
    range.count = object.number("count", max_units, 1);
    range.type = static_cast<std::uint8_t>(object.choice("type", device_type_words, no_device, disk));
    range.vendor = object.text("vendor", 8, "ZEMLAR");
    range.product = object.text("product", 16, usual_product(range.type));
    range.revision = object.text("revision", 4, "1.00");
    range.serial = object.text("serial", 64, "");
    range.serial_page = object.boolean("serial_page", true);
    range.block_size = std::max(1U, object.number("block_size", 65536, 512));
    range.blocks = std::max<std::uint64_t>(1, object.number("capacity", max_capacity, 1024) * MiB / range.block_size);
    range.state = static_cast<Unit_State>(object.choice("state", unit_state_words, unit_state_words.size() - 1, 0));
    range.identification =
        static_cast<Identification>(object.choice("identification", identification_words, identification_words.size() - 1, 0));
    range.descriptors = object.bytes("descriptors", 1024);
    range.inquiry = object.bytes("inquiry", 255);
    range.page_80 = object.bytes("page_80", 1024);
    range.page_83 = object.bytes("page_83", 1024);
    object.done();
    return range;
}

void take(std::bitset<max_units>& taken, const Unit_Range& range, const Json_Object& object)
{
    if (range.count > max_units - range.first)
        refuse(object.place(), "LUNs beyond " + std::to_string(max_units - 1));
    for (auto number = range.first; number < range.first + range.count; ++number)
    {
        if (taken[number])
            refuse(object.place(), "LUN " + std::to_string(number) + " is taken");
        taken.set(number);
    }
}

} // namespace

void read_units(Json_Object& object, Remote_Port& remote)
{
    auto& target = remote.scsi;
    target.name = remote.nwwn;
    target.flat = object.boolean("flat_luns", false);
    target.report_luns = object.bytes("report_luns", 65536);
    auto ranges = object.objects("luns", max_ranges);
    if (!object.has("luns") && remote.is_target())
        ranges.push_back(Json_Object::empty(object.place_of("luns"))); // one disk
    std::bitset<max_units> taken;
    for (auto& entry : ranges)
    {
        const auto next = target.units.empty() ? 0 : target.units.back().first + target.units.back().count;
        target.units.push_back(read_range(entry, std::min(next, max_units - 1)));
        take(taken, target.units.back(), entry);
    }
}

} // namespace hxasim
