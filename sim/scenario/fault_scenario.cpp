#include "sim/scenario/fault_scenario.h"

#include "sim/model/fabric.h"
#include "sim/model/record_fields.h"
#include "sim/scenario/scenario_words.h"

#include "hxal/records/scsi.h"

#include <limits>

namespace hxasim
{

namespace
{

constexpr std::uint32_t max_requests = 1'000'000'000;
constexpr std::uint32_t max_delay = 600'000;
constexpr std::uint32_t max_data = 64 * 1024 * 1024;

std::vector<Patch> read_patches(Json_Object& object, std::string_view key, std::uint32_t last)
{
    std::vector<Patch> patches;
    for (auto& patch : object.objects(key, 64))
    {
        patches.push_back({.offset = patch.number("offset", last, 0), .bytes = patch.bytes("bytes", max_record_size)});
        patch.done();
    }
    return patches;
}

template <typename Number> std::optional<Number> read_optional(Json_Object& object, std::string_view key, std::uint32_t most)
{
    const auto number = object.number(key, most);
    return number ? std::optional(static_cast<Number>(*number)) : std::nullopt;
}

} // namespace

Fault read_fault(Json_Object& object)
{
    Fault fault;
    fault.command = object.text("command", 64, "");
    fault.node = object.text("node", 64, "");
    fault.instance = read_optional<int>(object, "instance", 0xFFFF);
    if (object.has("remote_port"))
        fault.remote_port = object.address("remote_port", Wwn{});
    fault.lun = object.number("lun", max_units - 1);
    fault.cdb = object.bytes("cdb", sizeof(scsi_cdb_t));
    fault.error = static_cast<int>(object.choice("error", errno_words, 4095, 0));
    fault.status = object.number("status", max_u32, 0);
    fault.delay = static_cast<int>(object.number("delay", max_delay, 0));
    fault.skip = static_cast<int>(object.number("skip", max_requests, 0));
    fault.times = read_optional<int>(object, "times", max_requests).value_or(fault.times);
    fault.answer = read_patches(object, "answer", max_record_size);
    fault.scsi_status = read_optional<std::uint8_t>(object, "scsi_status", 255);
    fault.data = read_patches(object, "data", max_data);
    fault.garbage = object.number("garbage", max_u32);
    object.done();
    return fault;
}

} // namespace hxasim
