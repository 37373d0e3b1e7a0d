// CMPI_Adapter: the bridge between a CIM server's CMPI calls and one provider.
//
// One adapter exists per loaded provider. Its static functions are what the server calls through the function tables: each
// finds the adapter of its interface, works under the adapter's lock with a thread context pushed, and answers a return
// code without a message. No exception leaves them.
//
// What guards a request, in the order in which it is taken. Whoever holds one takes none that stands before it.
//
//   life_lock          (entry.h, the process's) while adapters are looked up, made and deleted; nobody waits for a thread
//                      under it
//   requests           entered by every request from its look-up to its end; a cleanup shuts it and waits until all have left
//   indication_switch  while indications are switched on or off
//   lock               for the work of a request and for a delivery
//   broker_gate        entered by provider threads for each use of the broker; a cleanup shuts it when the provider is unloaded
//
// Let go on the way: `lock` by a request that switches indications, before it takes the switch: enabling takes it again for the
// provider's call, disabling does not, because the provider joins its delivery thread meanwhile. A cleanup takes neither `lock`
// nor the switch: it waits for the requests instead, and for the threads that the provider joins when it unloads.
#pragma once

#include "cmpi/gate.h"
#include "cmpi/provider_handle.h"
#include "cmpi/static_data.h"
#include "runtime/assert.h"
#include "runtime/magic.h"
#include "runtime/mutex.h"

#include <cmpift.h>

#include <atomic>
#include <memory>
#include <vector>

namespace zmlr
{

// A name space with active indication filters.
struct Name_Space_Entry
{
    String name;
    uint32 count; // filters
};

class CMPI_Adapter : public Provider_Handle
{
public:
    // Makes and loads the provider and attaches itself to the static data. Nothing stays behind when it throws.
    CMPI_Adapter(const CMPIBroker* cmpi_broker, const CMPIContext* cmpi_context, const char* provider_name,
                 const Registration* registration, CMPI_Static_Data* static_data);

    // Detaches itself from the static data and deletes the provider.
    ~CMPI_Adapter();

    // The adapter of an interface that a server holds. A broken one is an internal-consistency failure.
    template <class MI> static CMPI_Adapter* of(MI* mi);

    // The class that a request for `path` works on, or null when this provider does not serve it. A server may route a
    // request by a superclass: it means the provider's own class then.
    const Meta_Class* requested_class(const CMPIObjectPath* path) const;

    // ---- what servers call: instances ----

    static CMPIStatus instanceCleanup(CMPIInstanceMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept;
    static CMPIStatus enumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path) noexcept;
    static CMPIStatus enumInstances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                    const CMPIObjectPath* path, const char** properties) noexcept;
    static CMPIStatus getInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                  const CMPIObjectPath* path, const char** properties) noexcept;
    static CMPIStatus createInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path, const CMPIInstance* instance) noexcept;
    static CMPIStatus modifyInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path, const CMPIInstance* instance, const char** properties) noexcept;
    static CMPIStatus deleteInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path) noexcept;
    static CMPIStatus execQuery(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                const CMPIObjectPath* path, const char* query, const char* language) noexcept;

    // ---- what servers call: methods, associations, indications ----

    static CMPIStatus methodCleanup(CMPIMethodMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept;
    static CMPIStatus invokeMethod(CMPIMethodMI* mi, const CMPIContext* context, const CMPIResult* result,
                                   const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out) noexcept;

    static CMPIStatus associationCleanup(CMPIAssociationMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept;
    static CMPIStatus associators(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                  const CMPIObjectPath* path, const char* assoc_class, const char* result_class, const char* role,
                                  const char* result_role, const char** properties) noexcept;
    static CMPIStatus associatorNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                      const CMPIObjectPath* path, const char* assoc_class, const char* result_class,
                                      const char* role, const char* result_role) noexcept;
    static CMPIStatus references(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                 const CMPIObjectPath* path, const char* result_class, const char* role,
                                 const char** properties) noexcept;
    static CMPIStatus referenceNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path, const char* result_class, const char* role) noexcept;

    static CMPIStatus indicationCleanup(CMPIIndicationMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept;
    static CMPIStatus authorizeFilter(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp* filter,
                                      const char* class_name, const CMPIObjectPath* path, const char* owner) noexcept;
    // Later editions of the interface headers declare one parameter more: whatever they are, they are not looked at.
    template <class... Arguments> static CMPIStatus mustPoll(CMPIIndicationMI* mi, Arguments...) { return never_poll(mi); }
    static CMPIStatus activateFilter(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp* filter,
                                     const char* class_name, const CMPIObjectPath* path, CMPIBoolean first) noexcept;
    static CMPIStatus deactivateFilter(CMPIIndicationMI* mi, const CMPIContext* context, const CMPISelectExp* filter,
                                       const char* class_name, const CMPIObjectPath* path, CMPIBoolean last) noexcept;
    static CMPIStatus enableIndications(CMPIIndicationMI* mi, const CMPIContext* context) noexcept;
    static CMPIStatus disableIndications(CMPIIndicationMI* mi, const CMPIContext* context) noexcept;

    Magic<0x2301490A> magic;
    const CMPIBroker* broker; // the one of the first factory call: servers may have one per provider
    CMPI_Static_Data* sd;
    uint32 load_count = 1; // interfaces that the server holds
    std::atomic<bool> allow_unload = true;
    std::vector<Name_Space_Entry> name_spaces; // in the order of their first filters
    const Meta_Class* mc = nullptr;
    bool indications_enabled = false;
    Gate requests;
    Mutex indication_switch{true};
    Mutex lock{true};
    std::shared_ptr<Gate> broker_gate = std::make_shared<Gate>(); // provider threads may outlive the adapter

private:
    static CMPIStatus never_poll(CMPIIndicationMI* mi) noexcept;
    void attach(const char* provider_name);
    void detach();
};

template <class MI> CMPI_Adapter* CMPI_Adapter::of(MI* mi)
{
    check(mi != nullptr, "mi != 0");
    auto* sd = static_cast<CMPI_Static_Data*>(const_cast<void*>(static_cast<const void*>(mi->hdl)));
    check(sd != nullptr, "sd != 0");
    check(sd->magic == STATIC_DATA_MAGIC, "sd->magic == STATIC_DATA_MAGIC");
    check(sd->adapter != nullptr, "sd->adapter");
    check(static_cast<bool>(sd->adapter->magic), "sd->adapter->magic");
    return sd->adapter;
}

} // namespace zmlr
