#include "sim/control/control_requests.h"

#include "sim/driver/simulator.h"
#include "sim/scenario/event_words.h"
#include "sim/scenario/fault_scenario.h"
#include "sim/scenario/scenario_words.h"

#include <limits>

namespace hxasim
{

namespace
{

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

using List = Json_Value::List;
using Members = Json_Value::Members;

Json_Value number(std::uint64_t value) { return {value}; }
Json_Value text(std::string_view value) { return {std::string(value)}; }

// The word of a number, or the number where there is no word.
Json_Value worded(std::span<const Choice> words, std::uint32_t value)
{
    for (const auto& choice : words)
        if (choice.value == value)
            return text(choice.word);
    return number(value);
}

template <typename Items, typename Write> Json_Value list_of(const Items& items, Write write)
{
    List list;
    for (const auto& item : items)
        list.push_back(write(item));
    return {list};
}

Json_Value write_function(const Function_Summary& function)
{
    return {Members{{"node", text(path_of(function.node))},
                    {"instance", number(function.instance)},
                    {"ioc", worded(ioc_state_words, function.ioc_state)},
                    {"port", worded(port_state_words, function.port_state)}}};
}

Json_Value write_port(const Port_Summary& port)
{
    return {Members{{"sfp", {port.sfp}}, {"functions", list_of(port.functions, write_function)}}};
}

Json_Value write_card(const Card_Summary& card)
{
    return {Members{{"serial", text(card.serial)},
                    {"model", text(card.model)},
                    {"plugged", {card.plugged}},
                    {"option_rom", {card.option_rom}},
                    {"ports", list_of(card.ports, write_port)}}};
}

Members raise_event(Simulator& simulator, Json_Object& object)
{
    Event event;
    event.category = object.choice("category", event_category_words, max_u32, 0);
    event.type = object.choice("event", event_words(event.category), max_u32, 0);
    event.node = object.text("node", 64, event.category == HXA_AEN_CAT_ETHPORT ? "/dev/hxn" : "/dev/hxa");
    event.instance = static_cast<int>(object.number("instance", max_instances - 1, 0));
    event.level = static_cast<std::int16_t>(object.number("level", max_i16, 0));
    event.data = object.bytes("data", sizeof(hxa_aen_data_t));
    const auto count = object.number("count", Event_Log::capacity, 1);
    object.done();
    for (std::uint32_t raised = 0; raised < count; ++raised)
        simulator.raise_event(event);
    return {};
}

template <bool plugged> Members plug(Simulator& simulator, Json_Object& object)
{
    const auto adapter = required(object, "adapter", max_instances);
    object.done();
    simulator.plug(adapter, plugged);
    return {};
}

// What a request does to a port; `key` has the word that says so.
Members change_port(Simulator& simulator, Json_Object& object, std::string_view key, std::span<const Choice> words,
                    void (Simulator::*change)(std::size_t adapter, std::size_t port, bool on))
{
    const auto adapter = required(object, "adapter", max_instances);
    const auto port = required(object, "port", max_instances);
    const bool on = object.word(key, words) != 0;
    object.done();
    (simulator.*change)(adapter, port, on);
    return {};
}

Members change_link(Simulator& simulator, Json_Object& object)
{
    return change_port(simulator, object, "link", link_words, &Simulator::link);
}
Members change_sfp(Simulator& simulator, Json_Object& object)
{
    return change_port(simulator, object, "module", sfp_words, &Simulator::sfp);
}

Members inject(Simulator& simulator, Json_Object& object)
{
    simulator.inject(read_fault(object), object.place());
    return {};
}

Members clear_faults(Simulator& simulator, Json_Object& object)
{
    object.done();
    simulator.clear_faults();
    return {};
}

Members count_requests(Simulator& simulator, Json_Object& object)
{
    object.done();
    return {{"requests", number(simulator.request_count())}};
}

Members tell_status(Simulator& simulator, Json_Object& object)
{
    object.done();
    List lost;
    for (std::uint32_t application = 1; application <= max_application; ++application)
        lost.push_back(number(simulator.lost_events(application)));
    return {{"adapters", list_of(simulator.cards(), write_card)},
            {"faults", number(simulator.fault_count())},
            {"lost_events", {lost}},
            {"open_descriptors", number(static_cast<std::uint64_t>(simulator.open_descriptors()))},
            {"remembered", number(simulator.remembered_requests())},
            {"requests", number(simulator.request_count())},
            {"violations", list_of(simulator.violations(), text)}};
}

struct Control_Request
{
    std::string_view name;
    Members (*answer)(Simulator& simulator, Json_Object& object);
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

Members answer(Simulator& simulator, std::string_view line)
{
    const Json_Document document(line);
    auto object = document.root("request");
    const auto name = object.text("request", 64, "");
    for (const auto& request : control_requests)
        if (request.name == name)
            return request.answer(simulator, object);
    refuse(object.place_of("request"), "no such request: " + name);
}

} // namespace

std::string answer_control(Simulator& simulator, std::string_view line)
{
    Members answered;
    try
    {
        answered = answer(simulator, line);
        answered["ok"] = {true};
    }
    catch (const std::bad_alloc&)
    {
        throw;
    }
    catch (const std::exception& error)
    {
        answered = {{"ok", {false}}, {"error", text(error.what())}};
    }
    return json_text({answered});
}

} // namespace hxasim
