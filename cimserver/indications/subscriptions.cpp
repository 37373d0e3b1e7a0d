#include "cimserver/indications/subscriptions.h"

#include "cimserver/indications/export_message.h"
#include "cimserver/interop/interop_operations.h"
#include "cimserver/interop/server_schema.h"
#include "cimserver/model/names.h"
#include "cimserver/model/paths.h"
#include "cimserver/operations/typed_objects.h"
#include "cimserver/security/bounded_log.h"

#include <algorithm>
#include <chrono>
#include <system_error>

namespace cimserver
{
namespace
{

using Kind = Subscription_Kind;

const Object_Path& reference(const Instance& subscription, const char* end)
{
    const Named_Value* key = find_named(subscription.path.keys, end);
    return key->value.get<Object_Path>();
}

void set_reference(Instance& subscription, const char* end, const Object_Path& path)
{
    const Value value{CMPI_ref, path};
    find_named(subscription.path.keys, end)->value = value;
    subscription.properties.put(end, value);
}

} // namespace

Subscriptions::Subscriptions(Module& module, Delivery& delivery, Indication_Order order, const Subscription_Store* store)
    : _module(module)
    , _delivery(delivery)
    , _store(store)
    , _providers(module, order)
    , _routes(std::make_shared<const std::vector<Route>>())
{
}

std::vector<Instance> Subscriptions::list(Kind kind) const
{
    const std::lock_guard lock(_data);
    std::vector<Instance> instances;
    for (const auto& [id, entry] : table(kind))
        instances.push_back(entry.instance);
    return instances;
}

Subscriptions::Entry Subscriptions::checked(Kind kind, Instance instance) const
{
    Entry entry;
    instance.path.host = {};
    instance.path.name_space = Interop_Operations::name_space;
    if (kind == Kind::filter)
    {
        entry.instance = complete_filter(std::move(instance));
        entry.filter = std::make_shared<const Event_Filter>(event_filter(entry.instance, _module.repository()));
    }
    else if (kind == Kind::destination)
        entry.instance = complete_destination(std::move(instance));
    else
    {
        entry.instance = complete_subscription(std::move(instance));
        tie(entry);
    }
    return entry;
}

// The subscription's references become the stored objects' own paths. The handler may be named by its superclass.
void Subscriptions::tie(Entry& subscription) const
{
    const auto find = [&](Kind kind, const char* end, const zmlr::Meta_Class& meta_class)
    {
        Object_Path path = reference(subscription.instance, end);
        if (equal_names(path.class_name, CIM_ListenerDestination.name))
            path.class_name = meta_class.name;
        const std::string id = path_identity(path);
        const auto found = table(kind).find(id);
        if (found == table(kind).end())
            throw Cim_Error(CIM_ERR_INVALID_PARAMETER, std::string("the subscription's ") + end + " does not exist");
        set_reference(subscription.instance, end, found->second.instance.path);
        return id;
    };
    subscription.filter_id = find(Kind::filter, "Filter", CIM_IndicationFilter);
    subscription.destination_id = find(Kind::destination, "Handler", CIM_ListenerDestinationCIMXML);
}

bool Subscriptions::in_use(Kind kind, const std::string& id) const
{
    return std::ranges::any_of(table(Kind::subscription), [&](const auto& entry)
                               { return (kind == Kind::filter ? entry.second.filter_id : entry.second.destination_id) == id; });
}

Provider_Filter Subscriptions::provider_filter(const std::string& filter_id) const
{
    const Entry& filter = table(Kind::filter).at(filter_id);
    return {filter.instance.properties.find("Query")->get<Text>(), filter.filter->query.class_name(),
            Module_Operations::served_name_space};
}

void Subscriptions::insert(Kind kind, const std::string& id, Entry entry)
{
    const std::lock_guard lock(_data);
    table(kind).emplace(id, std::move(entry));
    update_routes();
}

Subscriptions::Entry Subscriptions::take(Kind kind, const std::string& id)
{
    const std::lock_guard lock(_data);
    Entry entry = std::move(table(kind).extract(id).mapped());
    update_routes();
    return entry;
}

void Subscriptions::update_routes()
{
    std::map<std::string, Route> by_filter;
    std::set<std::string> urls;
    for (const auto& [id, subscription] : table(Kind::subscription))
    {
        const Instance& destination = table(Kind::destination).at(subscription.destination_id).instance;
        const auto& url = destination.properties.find("Destination")->get<Text>();
        Route& route = by_filter[subscription.filter_id];
        route.filter = table(Kind::filter).at(subscription.filter_id).filter;
        route.urls.push_back(url);
        urls.insert(url);
    }
    auto routes = std::make_shared<std::vector<Route>>();
    for (auto& [id, route] : by_filter)
        routes->push_back(std::move(route));
    _routes = std::move(routes);
    _delivery.keep(urls);
}

void Subscriptions::save() const
{
    if (!_store)
        return;
    try
    {
        Stored_Instances instances{list(Kind::filter), list(Kind::destination), list(Kind::subscription)};
        for (std::size_t kind = 0; kind < instances.size(); ++kind)
            instances[kind].insert(instances[kind].end(), _aside[kind].begin(), _aside[kind].end());
        _store->save(instances);
    }
    catch (const std::system_error& error)
    {
        throw Cim_Error(CIM_ERR_FAILED, error.what());
    }
}

Subscriptions::Change Subscriptions::begin_change()
{
    // By the wall clock: the thread sanitizer of clang 14 does not see a lock that is taken by the steady one.
    Change change(_changes, std::chrono::system_clock::now() + Module::usual_patience);
    if (!change)
        throw Cim_Error(CIM_ERR_FAILED, "an earlier change of subscriptions does not end: a provider does not answer");
    return change;
}

Object_Path Subscriptions::create(Kind kind, Instance instance)
{
    const Change change = begin_change();
    Entry entry = checked(kind, std::move(instance));
    const Object_Path path = entry.instance.path;
    const std::string id = path_identity(path);
    if (table(kind).contains(id))
        throw Cim_Error(CIM_ERR_ALREADY_EXISTS, "there is such an instance of " + path.class_name.string() + " already");
    if (table(kind).size() >= max_of_a_kind)
        throw Cim_Error(CIM_ERR_SERVER_LIMITS_EXCEEDED, "there are too many instances of " + path.class_name.string());

    const std::string filter_id = entry.filter_id;
    const bool starts = kind == Kind::subscription && !in_use(Kind::filter, filter_id);
    insert(kind, id, std::move(entry));
    try
    {
        if (starts)
            _providers.start(filter_id, provider_filter(filter_id));
        save();
    }
    catch (...)
    {
        if (starts)
            _providers.stop(filter_id); // does nothing unless it has started
        take(kind, id);
        throw;
    }
    return path;
}

void Subscriptions::remove(Kind kind, const Object_Path& path)
{
    const Change change = begin_change();
    const std::string id = path_identity(path);
    if (!table(kind).contains(id))
        throw Cim_Error(CIM_ERR_NOT_FOUND, "there is no such instance of " + path.class_name.string());
    if (in_use(kind, id))
        throw Cim_Error(CIM_ERR_FAILED, "a subscription uses this instance of " + path.class_name.string());

    Entry entry = take(kind, id);
    try
    {
        save();
    }
    catch (...)
    {
        insert(kind, id, std::move(entry));
        throw;
    }
    if (kind == Kind::subscription && !in_use(Kind::filter, entry.filter_id))
        _providers.stop(entry.filter_id);
}

// Everything is stored before the first provider is called: a provider may raise indications at once.
void Subscriptions::restore()
{
    if (!_store)
        return;
    const std::lock_guard change(_changes);
    const Repository classes(server_registrations());
    Bounded_Log log("more stored objects are kept aside");
    Stored_Instances stored = _store->load();
    for (const Kind kind : {Kind::filter, Kind::destination, Kind::subscription})
        for (Instance& instance : stored[static_cast<std::size_t>(kind)])
            try
            {
                Instance asked = instance;
                asked.path.name_space = Interop_Operations::name_space;
                const Class_Entry& own = *classes.find(asked.path.class_name);
                Entry entry = checked(kind, typed_instance(classes, own, asked, CIM_ERR_INVALID_PARAMETER));
                const std::string id = path_identity(entry.instance.path);
                insert(kind, id, std::move(entry));
            }
            catch (const Cim_Error& error)
            {
                log.tell(_store->file() + ": kept aside, because this module cannot serve it: " + error.what());
                _aside[static_cast<std::size_t>(kind)].push_back(std::move(instance));
            }
    std::map<std::string, Provider_Filter> filters;
    for (const auto& [id, subscription] : table(Kind::subscription))
        filters.emplace(subscription.filter_id, provider_filter(subscription.filter_id));
    _providers.start_all({filters.begin(), filters.end()});
}

void Subscriptions::stop()
{
    const std::lock_guard change(_changes);
    _providers.stop_all();
}

// On a thread of the module's, which holds locks of its own: nothing here waits.
void Subscriptions::deliver(const std::string& name_space, const Instance& indication)
{
    std::shared_ptr<const std::vector<Route>> routes;
    {
        const std::lock_guard lock(_data);
        routes = _routes;
    }
    const Class_Entry* entry = _module.repository().find(indication.path.class_name);
    if (!entry || !equal_names(name_space, Module_Operations::served_name_space))
        return;
    for (const Route& route : *routes)
    {
        const Event_Filter& filter = *route.filter;
        if (Repository::is_a(entry->meta_class, filter.entry->meta_class) && filter.query.wants(indication))
            _delivery.send(route.urls, export_message(filter.query.selected(indication)));
    }
}

} // namespace cimserver
