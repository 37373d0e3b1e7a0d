// Subscriptions: the filters, destinations and subscriptions of the server, and the way of an indication from the module to
// the listeners.
//
// While a subscription exists its filter is active with the providers (indication_providers.h) and its destination has a queue
// (delivery.h). Changes are made one at a time, and are saved before they are answered; reading and delivering wait for no
// provider, no disk and no listener.
#pragma once

#include "cimserver/broker/broker.h"
#include "cimserver/indications/delivery.h"
#include "cimserver/indications/indication_providers.h"
#include "cimserver/indications/subscription_rules.h"
#include "cimserver/indications/subscription_store.h"

#include <array>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

namespace cimserver
{

class Subscriptions : public Indication_Sink
{
public:
    static constexpr std::size_t max_of_a_kind = 1000;

    // Without a store (null) nothing outlives the process. What is handed over must outlive this object.
    Subscriptions(Module& module, Delivery& delivery, Indication_Order order, const Subscription_Store* store);

    // Takes up what the store holds; once, before the first change, when the module may already be called. What the module cannot
    // serve any more, because a class or a property is gone, is kept aside: it stays in the store. Throws std::runtime_error
    // when the store is damaged. A provider that cannot be enabled does not count. Standard error tells of both.
    void restore();

    // Disables all indications; what is stored stays. No change afterwards.
    void stop();

    std::vector<Instance> list(Subscription_Kind kind) const;

    // Stores an instance (subscription_rules.h) and returns its path. Throws Cim_Error: also ALREADY_EXISTS,
    // SERVER_LIMITS_EXCEEDED, INVALID_PARAMETER for a filter or destination that is not there, and what a provider answers.
    Object_Path create(Subscription_Kind kind, Instance instance);

    // Throws Cim_Error: NOT_FOUND, FAILED while a subscription uses it.
    void remove(Subscription_Kind kind, const Object_Path& path);

    void deliver(const std::string& name_space, const Instance& indication) override;

private:
    struct Entry
    {
        Instance instance;
        std::shared_ptr<const Event_Filter> filter; // of a filter
        std::string filter_id;                      // of a subscription
        std::string destination_id;
    };
    struct Route
    {
        std::shared_ptr<const Event_Filter> filter;
        std::vector<std::string> urls;
    };
    using Table = std::map<std::string, Entry>;
    using Change = std::unique_lock<std::timed_mutex>;

    Change begin_change(); // throws Cim_Error when the one before it does not end: a provider hangs

    Table& table(Subscription_Kind kind) { return _tables[static_cast<std::size_t>(kind)]; }
    const Table& table(Subscription_Kind kind) const { return _tables[static_cast<std::size_t>(kind)]; }
    Entry checked(Subscription_Kind kind, Instance instance) const;
    void tie(Entry& subscription) const;
    bool in_use(Subscription_Kind kind, const std::string& id) const;
    Provider_Filter provider_filter(const std::string& filter_id) const;
    void insert(Subscription_Kind kind, const std::string& id, Entry entry);
    Entry take(Subscription_Kind kind, const std::string& id);
    void update_routes();
    void save() const;

    Module& _module;
    Delivery& _delivery;
    const Subscription_Store* const _store;
    std::timed_mutex _changes;       // one change at a time
    Indication_Providers _providers; // guarded by it
    Stored_Instances _aside;         // too
    mutable std::mutex _data;        // guards what follows against readers; never held while others are called
    std::array<Table, 3> _tables;
    std::shared_ptr<const std::vector<Route>> _routes;
};

} // namespace cimserver
