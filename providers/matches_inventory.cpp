#include "providers/matches_inventory.h"

#include "inventory/adapter_lookup.h"
#include "inventory/adapter_software_identity.h"
#include "inventory/address_text.h"
#include "inventory/cim_values.h"
#include "inventory/ethernet_port_helper.h"
#include "inventory/fchba_manager.h"
#include "providers/joining.h"
#include "providers/key_index.h"
#include "runtime/ascii.h"
#include "schema/CIM_LogicalDevice.h"
#include "schema/ZEMLAR_SCSIInitiatorTargetLogicalUnitPath.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <optional>
#include <string_view>

namespace zmlr
{

namespace
{

std::string_view view(const String& text) { return {text.c_str(), text.size()}; }
std::string_view view(const Property<String>& text) { return text.null ? std::string_view() : view(text.value); }
String text_of(std::string_view text) { return String(text.data(), text.size()); }

// ---- connectors ----

// Where a connector is.
struct Slot
{
    int adapter;
    int port;
};

// The number behind the last "_", which is cut off with it.
std::optional<int> cut_number(std::string_view& tag)
{
    const std::size_t line = tag.rfind('_');
    if (line == std::string_view::npos)
        return std::nullopt;
    const char* end = tag.data() + tag.size();
    const char* begin = tag.data() + line + 1;
    int number = 0;
    const auto [stop, error] = std::from_chars(begin, end, number);
    if (error != std::errc() || stop != end || !ascii::is_digit(*begin))
        return std::nullopt;
    tag.remove_suffix(tag.size() - line);
    return number;
}

// A tag is read from its end: the serial number before the indexes may hold "_" itself.
std::optional<Slot> slot_of(const ZEMLAR_PhysicalConnector& connector)
{
    std::string_view tag = view(connector.Tag);
    const std::optional<int> port = cut_number(tag);
    const std::optional<int> adapter = port ? cut_number(tag) : std::nullopt;
    return adapter ? std::optional(Slot{*adapter, *port}) : std::nullopt;
}

// ---- software ----

constexpr std::size_t longest_name = 63;

std::string_view name_of(const ZEMLAR_AdapterSoftwareIdentity& software)
{
    const std::string_view id = view(software.InstanceID).substr(0, longest_name);
    return id.substr(0, id.find('_'));
}

bool is_driver(const ZEMLAR_AdapterSoftwareIdentity& software)
{
    const Property<Array<uint16>>& classes = software.Classifications;
    return !classes.null && std::ranges::find(classes.value, SOFTWARE_DRIVER) != classes.value.end();
}

bool runs_on(const ZEMLAR_AdapterSoftwareIdentity& software, const ZEMLAR_PortController& controller, const char* log_source)
{
    const std::string_view name = name_of(software);
    if (name.empty())
    {
        ZMLR_LOG(LL_INFO, "No MAC or NWWN returned from strtok function");
        return false;
    }
    const bool is_fc = !controller.ControllerType.null && controller.ControllerType.value == CONTROLLER_TYPE_FC;
    return !is_fc || !eqi(text_of(name).c_str(), "hxn");
}

// ---- units ----

// What a unit's identifier begins with: the names of its initiator and of its target.
std::string_view names_in(std::string_view id)
{
    const std::size_t line = id.find('_');
    return line == std::string_view::npos ? std::string_view() : id.substr(0, id.find('_', line + 1));
}

// The ends of the path to a unit; null where there are none.
struct Ends
{
    std::string_view names;
    Instance* initiator = nullptr;
    Instance* target = nullptr;
};

// Endpoints are named by the initiator, or by initiator and target.
Ends ends_of(std::string_view names, const Instance_Array& endpoints, const Key_Index& by_name)
{
    const auto first = [&](std::string_view name)
    {
        const std::vector<uint32>& positions = by_name.at(name);
        return positions.empty() ? nullptr : endpoints[positions.front()];
    };
    return {names, first(names.substr(0, names.find('_'))), first(names)};
}

Ref<Instance> path_to(Instance* unit, const Ends& ends)
{
    Ref<ZEMLAR_SCSIInitiatorTargetLogicalUnitPath> path(ZEMLAR_SCSIInitiatorTargetLogicalUnitPath::create());
    set_reference(path->Initiator, ends.initiator);
    set_reference(path->Target, ends.target);
    set_reference(path->LogicalUnit, unit);
    return Ref<Instance>(path.steal());
}

} // namespace

Instance_Array fc_ports_of(const ZEMLAR_PortController& controller, const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getFCPortInstancesByAdapter(controller.DeviceID.value, request);
}

Instance_Array ethernet_ports_of(const ZEMLAR_PortController& controller, const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getEthernetPortInstancesByAdapter(controller.DeviceID.value, request);
}

Instance_Array ethernet_ports_beside(const ZEMLAR_PhysicalConnector& connector, const Inventory_Request& request)
{
    const std::optional<Slot> slot = slot_of(connector);
    const EthernetPortHelper& helper = EthernetPortHelper::getEthernetPortHelperObject();
    return slot ? helper.getInstancesByAdapterId(slot->adapter, CLASSID_EthernetPort, request) : Instance_Array();
}

String address_in_tag(const ZEMLAR_PhysicalPackage& package)
{
    return ProviderUtil::getNodeMACOrWWNFromTag(package.Tag.value, package.Model.value);
}

void software_on_controllers(Joining& joining)
{
    constexpr std::size_t identities = 0;
    constexpr std::size_t controllers = 1;
    if (!joining.ask_all())
        return;

    Key_Index by_address;
    std::vector<uint32> of_all; // what is looked at for every controller
    for (uint32 i = 0; i < joining[identities].size(); i++)
    {
        const auto* software = joining.at<ZEMLAR_AdapterSoftwareIdentity>(identities, i);
        if (software && (is_driver(*software) || name_of(*software).empty()))
            of_all.push_back(i);
        else if (software)
            by_address.add(text_of(name_of(*software)), i);
    }
    for (uint32 c = 0; c < joining[controllers].size(); c++)
    {
        auto* controller = joining.at<ZEMLAR_PortController>(controllers, c);
        if (!controller)
            continue;
        std::vector<uint32> candidates;
        std::ranges::merge(of_all, by_address.at(controller->DeviceID.value), std::back_inserter(candidates));
        for (const uint32 i : candidates)
        {
            auto* software = joining.at<ZEMLAR_AdapterSoftwareIdentity>(identities, i);
            if (runs_on(*software, *controller, joining.source()) && !joining.pair(identities, software, controllers, controller))
                return;
        }
    }
}

void connectors_in_packages(Joining& joining)
{
    constexpr std::size_t connectors = 0;
    constexpr std::size_t packages = 1;
    if (!joining.ask_all())
        return;

    Key_Index by_address;
    int adapter = -1;
    String address; // of the adapter; connectors come adapter by adapter
    for (uint32 i = 0; i < joining[connectors].size(); i++)
    {
        const auto* connector = joining.at<ZEMLAR_PhysicalConnector>(connectors, i);
        const std::optional<Slot> slot = connector ? slot_of(*connector) : std::nullopt;
        if (!slot)
            continue;
        if (slot->adapter != adapter)
            address = ProviderUtil::getAddrByAdapterId(slot->adapter);
        adapter = slot->adapter;
        by_address.add(address, i);
    }
    for (uint32 p = 0; p < joining[packages].size(); p++)
    {
        Instance* package = joining[packages][p];
        if (!package)
            continue;
        for (const uint32 i : by_address.at(joining.key(packages, p)))
        {
            if (!joining.pair(packages, package, connectors, joining[connectors][i]))
                return;
        }
    }
}

void ports_at_connectors(Joining& joining)
{
    constexpr std::size_t connectors = 0;
    constexpr std::size_t ports = 1;
    if (!joining.ask(connectors))
        return;
    joining.say_building();

    int adapter = -1; // whose ports were asked for; connectors come adapter by adapter
    for (uint32 i = 0; i < joining[connectors].size(); i++)
    {
        auto* connector = joining.at<ZEMLAR_PhysicalConnector>(connectors, i);
        const std::optional<Slot> slot = connector ? slot_of(*connector) : std::nullopt;
        if (!slot)
            continue;
        if (slot->adapter != adapter)
            joining.ask(ports, connector);
        adapter = slot->adapter;
        for (uint32 p = 0; p < joining[ports].size(); p++)
        {
            auto* port = joining.at<ZEMLAR_EthernetPort>(ports, p);
            const bool is_there = port && !port->PortNumber.null && port->PortNumber.value == slot->port;
            if (is_there && !joining.pair(connectors, connector, ports, port))
                return;
        }
    }
}

void paths_to_units(Joining& joining)
{
    constexpr std::size_t extents = 0;
    constexpr std::size_t tapes = 1;
    constexpr std::size_t endpoints = 2;
    joining.ask(extents);
    joining.ask(tapes);
    if (joining[extents].empty() && joining[tapes].empty())
    {
        joining.say_none(endpoints);
        return;
    }
    if (!joining.ask(endpoints))
        return;
    joining.say_building();

    const Key_Index by_name = index_of(joining, endpoints);
    Ends ends; // units come target by target
    for (const std::size_t side : {extents, tapes})
    {
        for (uint32 i = 0; i < joining[side].size(); i++)
        {
            Instance* unit = joining[side][i]; // holds the text that key() shares
            const std::string_view names = unit ? names_in(view(joining.key(side, i))) : std::string_view();
            if (names != ends.names)
                ends = ends_of(names, joining[endpoints], by_name);
            if (ends.initiator && ends.target && !joining.deliver(path_to(unit, ends)))
                return;
        }
    }
}

} // namespace zmlr
