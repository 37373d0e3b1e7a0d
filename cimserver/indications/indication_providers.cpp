#include "cimserver/indications/indication_providers.h"

#include "cimserver/broker/request.h"
#include "cimserver/operations/provider_call.h"

#include <cstdio>

namespace cimserver
{
namespace
{

// Takes a step whose failure changes nothing but what an administrator has to know.
template <class Step> void attempt(const Step& step)
{
    try
    {
        step();
    }
    catch (const Cim_Error& error)
    {
        std::fprintf(stderr, "zmlr-cimserver: indications: %s\n", error.what());
    }
}

// One call of a provider: its context, and the path that names its class.
struct Indication_Call
{
    Indication_Call(const Class_Entry& provider_, const std::string& name_space, const char* class_name)
        : provider(provider_)
        , path(make<Path_Object>(Object_Path{"", name_space, class_name, {}}).face())
    {
    }

    template <class MI, class Function, class... Arguments> void run(MI* mi, Function function, Arguments... arguments)
    {
        check_offered(provider, "indications", function != nullptr);
        check_status(provider, "indications", function(mi, request.context(), arguments...));
    }

    const Class_Entry& provider;
    Request request;
    CMPIObjectPath* path;
};

} // namespace

Indication_Providers::Indication_Providers(Module& module, Indication_Order order) : _module(module), _order(order) {}

Indication_Providers::~Indication_Providers() = default;

std::vector<Indication_Providers::Provider*> Indication_Providers::providers_of(const std::string& class_name)
{
    std::vector<Provider*> providers;
    const Class_Entry* named = _module.repository().find(class_name);
    if (named)
        for (const Class_Entry* entry : _module.repository().served(*named))
            if (CMPIIndicationMI* mi = _module.indication_mi(*entry))
                providers.push_back(&_providers.try_emplace(entry, Provider{entry, mi}).first->second);
    if (providers.empty())
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, "nobody raises indications of class " + class_name);
    return providers;
}

void Indication_Providers::activate_with(Active_Filter& active, Provider& provider)
{
    Indication_Call call(*provider.entry, active.filter.name_space, provider.entry->meta_class->name);
    const CMPISelectExp* expression = active.expression->face();
    const char* class_name = active.filter.class_name.c_str();
    const CMPIIndicationMIFT& calls = *provider.mi->ft;
    if (_order == Indication_Order::sfcb)
    {
        call.run(provider.mi, calls.authorizeFilter, expression, class_name, call.path, Principal_Scope::current().c_str());
        if (calls.mustPoll)
            calls.mustPoll(provider.mi, call.request.context(), expression, class_name, call.path);
    }
    call.run(provider.mi, calls.activateFilter, expression, class_name, call.path, provider.filters == 0);
    active.providers.push_back(&provider);
    ++provider.filters;
}

Indication_Providers::Active_Filter& Indication_Providers::activate(const std::string& name, const Provider_Filter& filter)
{
    const auto providers = providers_of(filter.class_name);
    Active_Filter active{filter, std::make_unique<Select_Object>(filter.query), {}};
    try
    {
        for (Provider* provider : providers)
            activate_with(active, *provider);
    }
    catch (...)
    {
        undo(active);
        throw;
    }
    return _active.insert_or_assign(name, std::move(active)).first->second;
}

void Indication_Providers::enable(Provider& provider)
{
    if (provider.enabled)
        return;
    Indication_Call(*provider.entry, "", "").run(provider.mi, provider.mi->ft->enableIndications);
    provider.enabled = true;
}

void Indication_Providers::enable(Active_Filter& active)
{
    for (Provider* provider : active.providers)
        enable(*provider);
}

void Indication_Providers::start(const std::string& name, const Provider_Filter& filter)
{
    const Module::Use use(_module);
    Active_Filter& active = activate(name, filter);
    try
    {
        enable(active);
    }
    catch (...)
    {
        undo(active);
        _active.erase(name);
        throw;
    }
}

void Indication_Providers::start_all(const std::vector<std::pair<std::string, Provider_Filter>>& filters)
{
    const Module::Use use(_module);
    for (const auto& filter : filters)
        attempt(
            [&]
            {
                Active_Filter& active = activate(filter.first, filter.second);
                if (_order == Indication_Order::sfcb)
                    enable(active);
            });
    if (_order == Indication_Order::open_pegasus)
        for (auto& active : _active)
            attempt([&] { enable(active.second); });
}

void Indication_Providers::disable(Provider& provider)
{
    if (!provider.enabled)
        return;
    provider.enabled = false;
    Indication_Call(*provider.entry, "", "").run(provider.mi, provider.mi->ft->disableIndications);
}

void Indication_Providers::deactivate(const Active_Filter& active, Provider& provider)
{
    --provider.filters;
    const bool nameless = _order == Indication_Order::sfcb;
    Indication_Call call(*provider.entry, active.filter.name_space, nameless ? "" : provider.entry->meta_class->name);
    call.run(provider.mi, provider.mi->ft->deActivateFilter, active.expression->face(),
             nameless ? "" : active.filter.class_name.c_str(), call.path, provider.filters == 0);
}

// Every step is taken, whatever the ones before it answered.
void Indication_Providers::undo(const Active_Filter& active)
{
    for (auto taker = active.providers.rbegin(); taker != active.providers.rend(); ++taker)
    {
        Provider& provider = **taker;
        const bool last = provider.filters == 1;
        if (last && _order == Indication_Order::sfcb)
            attempt([&] { disable(provider); });
        attempt([&] { deactivate(active, provider); });
        if (last && _order == Indication_Order::open_pegasus)
            attempt([&] { disable(provider); });
    }
}

void Indication_Providers::stop(const std::string& name)
{
    const auto found = _active.find(name);
    if (found == _active.end())
        return;
    const Module::Use use(_module);
    undo(found->second);
    _active.erase(found);
}

void Indication_Providers::stop_all()
{
    while (!_active.empty())
        stop(std::string(_active.begin()->first));
}

} // namespace cimserver
