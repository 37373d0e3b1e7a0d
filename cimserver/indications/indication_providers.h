// Indication_Providers: the calls that tell the module's providers which indications are wanted.
//
// A filter is activated while at least one subscription uses it, with every provider whose class it can concern; a provider's
// indications are enabled while it has an active filter. The two servers that people use make these calls in different orders,
// and a module must live with both:
//
//   sfcb           authorizeFilter, mustPoll, activateFilter, enableIndications; at the end disableIndications first, then
//                  deActivateFilter with an empty class name
//   open_pegasus   activateFilter, enableIndications, when several filters are there at the start all of the first before any
//                  of the second; at the end deActivateFilter, disableIndications
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/broker/objects.h"

#include <map>
#include <memory>
#include <string>
#include <vector>

namespace cimserver
{

enum class Indication_Order
{
    open_pegasus,
    sfcb
};

// A filter as providers are told of it.
struct Provider_Filter
{
    std::string query;
    std::string class_name; // as the query writes it
    std::string name_space; // where indications are wanted from
};

// Not safe for several threads at once. A call may take as long as the provider likes, and the provider may raise indications
// meanwhile.
class Indication_Providers
{
public:
    Indication_Providers(Module& module, Indication_Order order); // the module must outlive it
    ~Indication_Providers();
    Indication_Providers(const Indication_Providers&) = delete;
    Indication_Providers& operator=(const Indication_Providers&) = delete;

    // Activates the filter under a name of the caller's and enables the indications of its providers, for the thread's
    // principal. Throws Cim_Error, with nothing changed, when a provider refuses or no provider raises the class.
    void start(const std::string& name, const Provider_Filter& filter);

    // The same for several filters at the start of the server. What fails is told on standard error and stays
    // off; the next start() of a filter of the same provider tries to enable it again.
    void start_all(const std::vector<std::pair<std::string, Provider_Filter>>& filters);

    // Undoes start(). A provider that fails is told on standard error.
    void stop(const std::string& name);
    void stop_all();

private:
    struct Provider
    {
        const Class_Entry* entry;
        CMPIIndicationMI* mi;
        std::size_t filters = 0;
        bool enabled = false;
    };
    struct Active_Filter
    {
        Provider_Filter filter;
        std::unique_ptr<Select_Object> expression; // lives as long as providers may look at it
        std::vector<Provider*> providers;          // that took it
    };

    std::vector<Provider*> providers_of(const std::string& class_name);
    Active_Filter& activate(const std::string& name, const Provider_Filter& filter);
    void activate_with(Active_Filter& active, Provider& provider);
    void enable(Active_Filter& active);
    void enable(Provider& provider);
    void disable(Provider& provider);
    void deactivate(const Active_Filter& active, Provider& provider);
    void undo(const Active_Filter& active);

    Module& _module;
    const Indication_Order _order;
    std::map<const Class_Entry*, Provider> _providers;
    std::map<std::string, Active_Filter> _active;
};

} // namespace cimserver
