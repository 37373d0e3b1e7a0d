#include "sim/control_requests.h"

#include "sim/event_words.h"
#include "sim/fault_scenario.h"
#include "sim/scenario_words.h"
#include "sim/simulator.h"

#include <limits>

namespace hxasim
{

namespace
{

using nlohmann::json;

constexpr std::uint32_t max_u32 = std::numeric_limits<std::uint32_t>::max();
constexpr std::uint32_t max_i16 = std::numeric_limits<std::int16_t>::max();

constexpr std::array link_words{Choice{"down", false}, Choice{"up", true}};
constexpr std::array sfp_words{Choice{"remove", false}, Choice{"insert", true}};

std::uint32_t required(Json_Object& object, std::string_view key, std::uint32_t most)
{
    auto number = object.number(key, most);
    if (!number)
        refuse(object.place_of(key), "is missing");
    return *number;
}

// The word of a number, or the number where there is no word.
json worded(std::span<const Choice> words, std::uint32_t value)
{
    for (const auto& choice : words)
        if (choice.value == value)
            return choice.word;
    return value;
}

json written(const Port_Summary& port)
{
    json functions = json::array();
    for (const auto& function : port.functions)
        functions.push_back({{"node", path_of(function.node)},
                             {"instance", function.instance},
                             {"ioc", worded(ioc_state_words, function.ioc_state)},
                             {"port", worded(port_state_words, function.port_state)}});
    return {{"sfp", port.sfp}, {"functions", functions}};
}

json written(const Card_Summary& card)
{
    json ports = json::array();
    for (const auto& port : card.ports)
        ports.push_back(written(port));
    return {{"serial", card.serial},
            {"model", card.model},
            {"plugged", card.plugged},
            {"option_rom", card.option_rom},
            {"ports", ports}};
}

json raise_event(Json_Object& object)
{
    Event event;
    event.category = object.choice("category", event_category_words, max_u32, 0);
    event.type = object.choice("event", event_words(event.category), max_u32, 0);
    event.node = object.text("node", 64, event.category == HXA_AEN_CAT_ETHPORT ? "/dev/hxn" : "/dev/hxa");
    event.instance = static_cast<int>(object.number("instance", max_instances - 1, 0));
    event.level = static_cast<std::int16_t>(object.number("level", max_i16, 0));
    event.data = object.bytes("data", sizeof(hxa_aen_data_t));
    object.done();
    simulator().raise_event(event);
    return json::object();
}

template <bool plugged> json plug(Json_Object& object)
{
    const auto adapter = required(object, "adapter", max_instances);
    object.done();
    simulator().plug(adapter, plugged);
    return json::object();
}

// What a request does to a port; `key` has the word that says so.
json change_port(Json_Object& object, std::string_view key, std::span<const Choice> words,
                 void (Simulator::*change)(std::size_t adapter, std::size_t port, bool on))
{
    const auto adapter = required(object, "adapter", max_instances);
    const auto port = required(object, "port", max_instances);
    const bool on = object.word(key, words) != 0;
    object.done();
    (simulator().*change)(adapter, port, on);
    return json::object();
}

json change_link(Json_Object& object) { return change_port(object, "link", link_words, &Simulator::link); }
json change_sfp(Json_Object& object) { return change_port(object, "module", sfp_words, &Simulator::sfp); }

json inject(Json_Object& object)
{
    simulator().inject(read_fault(object));
    return json::object();
}

json clear_faults(Json_Object& object)
{
    object.done();
    simulator().clear_faults();
    return json::object();
}

json count_requests(Json_Object& object)
{
    object.done();
    return {{"requests", simulator().request_count()}};
}

json tell_status(Json_Object& object)
{
    object.done();
    auto& host = simulator();
    json adapters = json::array();
    for (const auto& card : host.cards())
        adapters.push_back(written(card));
    json lost = json::array();
    for (std::uint32_t application = 1; application <= max_application; ++application)
        lost.push_back(host.lost_events(application));
    return {{"adapters", adapters},
            {"faults", host.fault_count()},
            {"lost_events", lost},
            {"open_descriptors", host.open_descriptors()},
            {"requests", host.request_count()},
            {"violations", host.violations()}};
}

struct Control_Request
{
    std::string_view name;
    json (*answer)(Json_Object& object);
};

constexpr std::array control_requests{
    Control_Request{"event", raise_event},
    Control_Request{"unplug", plug<false>},
    Control_Request{"plug", plug<true>},
    Control_Request{"port", change_link},
    Control_Request{"sfp", change_sfp},
    Control_Request{"fault", inject},
    Control_Request{"clear-faults", clear_faults},
    Control_Request{"requests", count_requests},
    Control_Request{"status", tell_status},
};

json answer(std::string_view line)
{
    const auto root = json::parse(line);
    Json_Object object(root, "request");
    const auto name = object.text("request", 64, "");
    for (const auto& request : control_requests)
        if (request.name == name)
            return request.answer(object);
    refuse(object.place_of("request"), "no such request: " + name);
}

} // namespace

std::string answer_control(std::string_view line)
{
    json answered;
    try
    {
        answered = answer(line);
        answered["ok"] = true;
    }
    catch (const std::bad_alloc&)
    {
        throw;
    }
    catch (const std::exception& error)
    {
        answered = {{"ok", false}, {"error", error.what()}};
    }
    return answered.dump(-1, ' ', false, json::error_handler_t::replace);
}

} // namespace hxasim
