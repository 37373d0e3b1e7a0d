#include "cmpi/adapter.h"

#include "cmpi/cmpi_objects.h"
#include "cmpi/cmpi_trace.h"
#include "cmpi/thread_context.h"

#include <cmpimacs.h>

#include <cstdio>
#include <memory>
#include <new>

namespace zmlr
{

namespace
{

// Versions that a server reads from each function table.
constexpr int FT_VERSION = 100;
constexpr int MI_VERSION = 100;

void set_mi_name(char (&name)[MI_NAME_SIZE], const char* kind, const char* provider_name)
{
    std::snprintf(name, sizeof(name), "%s%s", kind, provider_name);
}

} // namespace

CMPI_Adapter::CMPI_Adapter(const CMPIBroker* cmpi_broker, const CMPIContext* cmpi_context, const char* provider_name,
                           const Registration* registration, CMPI_Static_Data* static_data)
    : Provider_Handle(registration)
    , broker(cmpi_broker)
    , sd(static_data)
{
    ent("CMPI_Adapter");
    const CMPI_Thread_Context_Pusher pusher(broker, cmpi_context, this);
    attach(provider_name);

    // A constructor that throws has no destructor: the static data must not keep pointing here.
    struct Detach
    {
        void operator()(CMPI_Adapter* adapter) const { adapter->detach(); }
    };
    std::unique_ptr<CMPI_Adapter, Detach> attached(this);
    load();
    get_meta_class(mc);
    static_cast<void>(attached.release());
    ret("CMPI_Adapter");
}

CMPI_Adapter::~CMPI_Adapter()
{
    check(sd->adapter == this, "sd->adapter == this");
    check(sd->magic == STATIC_DATA_MAGIC, "sd->magic == STATIC_DATA_MAGIC");
    detach();
}

// The tables are filled by position: between editions of the interface headers the names of some members differ, some members
// are constant and more stand at the end, but their order does not change. What stands at the end is not ours to serve.
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wmissing-field-initializers"
void CMPI_Adapter::attach(const char* provider_name)
{
    set_mi_name(sd->inst_mi_name, "instance", provider_name);
    set_mi_name(sd->meth_mi_name, "method", provider_name);
    set_mi_name(sd->indic_mi_name, "indication", provider_name);
    set_mi_name(sd->assoc_mi_name, "association", provider_name);

    // clang-format off
    new (&sd->instance_ft) CMPIInstanceMIFT{
        FT_VERSION, MI_VERSION, sd->inst_mi_name, instanceCleanup,
        enumInstanceNames, enumInstances, getInstance, createInstance, modifyInstance, deleteInstance, execQuery};
    new (&sd->method_ft) CMPIMethodMIFT{
        FT_VERSION, MI_VERSION, sd->meth_mi_name, methodCleanup,
        invokeMethod};
    new (&sd->indication_ft) CMPIIndicationMIFT{
        FT_VERSION, MI_VERSION, sd->indic_mi_name, indicationCleanup,
        authorizeFilter, mustPoll, activateFilter, deactivateFilter, enableIndications, disableIndications};
    new (&sd->association_ft) CMPIAssociationMIFT{
        FT_VERSION, MI_VERSION, sd->assoc_mi_name, associationCleanup,
        associators, associatorNames, references, referenceNames};
    // clang-format on

    sd->adapter = this;
    sd->magic = STATIC_DATA_MAGIC;
}
#pragma GCC diagnostic pop

void CMPI_Adapter::detach()
{
    sd->magic = DESTROYED_MAGIC;
    sd->adapter = nullptr;
}

const Meta_Class* CMPI_Adapter::requested_class(const CMPIObjectPath* path) const
{
    const Meta_Class* requested = find_meta_class(mc, class_name_of(path).c_str());
    if (!requested || is_subclass(mc, requested))
        return requested;
    return is_subclass(requested, mc) ? mc : nullptr;
}

} // namespace zmlr
