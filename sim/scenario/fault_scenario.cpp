#include "sim/scenario/fault_scenario.h"

#include "sim/model/record_fields.h"
#include "sim/scenario/scenario_words.h"

#include <limits>

namespace hxasim
{

namespace
{

constexpr std::uint32_t max_requests = 1'000'000'000;
constexpr std::uint32_t max_delay = 600'000;

Patch read_patch(Json_Object object)
{
    Patch patch{.offset = object.number("offset", max_record_size, 0), .bytes = object.bytes("bytes", max_record_size)};
    object.done();
    return patch;
}

} // namespace

Fault read_fault(Json_Object& object)
{
    Fault fault;
    fault.command = object.text("command", 64, "");
    fault.node = object.text("node", 64, "");
    if (auto instance = object.number("instance", 0xFFFF))
        fault.instance = static_cast<int>(*instance);
    fault.error = static_cast<int>(object.choice("error", errno_words, 4095, 0));
    fault.status = object.number("status", std::numeric_limits<std::uint32_t>::max(), 0);
    fault.delay = static_cast<int>(object.number("delay", max_delay, 0));
    fault.skip = static_cast<int>(object.number("skip", max_requests, 0));
    if (auto times = object.number("times", max_requests))
        fault.times = static_cast<int>(*times);
    for (auto& patch : object.objects("answer", 64))
        fault.answer.push_back(read_patch(patch));
    object.done();
    return fault;
}

} // namespace hxasim
