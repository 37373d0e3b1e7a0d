#include "cimserver/indications/subscription_classes.h"

#include "cimserver/interop/server_schema.h"

namespace cimserver
{
namespace
{

const zmlr::Meta_Class& class_of(Subscription_Kind kind)
{
    switch (kind)
    {
    case Subscription_Kind::filter:
        return CIM_IndicationFilter;
    case Subscription_Kind::destination:
        return CIM_ListenerDestinationCIMXML;
    case Subscription_Kind::subscription:
        break;
    }
    return CIM_IndicationSubscription;
}

class Subscription_Class : public Server_Class
{
public:
    Subscription_Class(Subscription_Kind kind, Subscriptions& subscriptions) : _kind(kind), _subscriptions(subscriptions) {}

    const zmlr::Meta_Class& meta_class() const override { return class_of(_kind); }
    std::vector<Instance> enumerate() override { return _subscriptions.list(_kind); }
    Object_Path create(const Instance& instance) override { return _subscriptions.create(_kind, instance); }
    void remove(const Object_Path& path) override { _subscriptions.remove(_kind, path); }

private:
    const Subscription_Kind _kind;
    Subscriptions& _subscriptions;
};

} // namespace

std::unique_ptr<Server_Class> make_subscription_class(Subscription_Kind kind, Subscriptions& subscriptions)
{
    return std::make_unique<Subscription_Class>(kind, subscriptions);
}

} // namespace cimserver
