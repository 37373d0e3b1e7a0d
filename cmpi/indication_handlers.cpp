// The indication interface of an adapter, and the delivery of what its provider raises.
#include "cmpi/converter.h"
#include "cmpi/request.h"
#include "cmpi/status_to_rc.h"
#include "runtime/log.h"

#include <algorithm>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "CMPI_Adapter";

// Lets go of a mutex for a scope.
class Auto_Unlock
{
public:
    explicit Auto_Unlock(Mutex& mutex) : _mutex(mutex) { _mutex.unlock(); }
    ~Auto_Unlock() { _mutex.lock(); }
    Auto_Unlock(const Auto_Unlock&) = delete;
    Auto_Unlock& operator=(const Auto_Unlock&) = delete;

private:
    Mutex& _mutex;
};

// ---- filters ----

std::vector<Name_Space_Entry>::iterator find_entry(std::vector<Name_Space_Entry>& entries, const String& name)
{
    return std::find_if(entries.begin(), entries.end(), [&](const Name_Space_Entry& entry) { return entry.name == name; });
}

void add_filter(std::vector<Name_Space_Entry>& entries, const String& name)
{
    const auto entry = find_entry(entries, name);
    if (entry == entries.end())
        entries.push_back({name, 1});
    else
        ++entry->count;
}

void remove_filter(std::vector<Name_Space_Entry>& entries, const String& name)
{
    const auto entry = find_entry(entries, name);
    if (entry != entries.end() && --entry->count == 0)
        entries.erase(entry);
}

// ---- delivery ----

void deliver(const CMPI_Thread_Context& thread_context, const Instance* indication, const char* name_space)
{
    trc(__LINE__, "delivering an indication to %s", name_space);
    CMPI_Ptr<CMPIInstance> cmpi_instance;
    const CMPIBroker* broker = thread_context.cmpi_broker();
    if (make_cmpi_instance(broker, share(indication), name_space, nullptr, nullptr, cmpi_instance) != CMPI_RC_OK)
        return;
    const CMPIStatus status = CBDeliverIndication(broker, thread_context.cmpi_context(), name_space, cmpi_instance.get());
    if (!okay(status))
        ZMLR_LOG(LL_WARN, "CBDeliverIndication() failed: %s", _rc_to_str(status.rc));
}

// What the provider calls for each indication that it raises, on a thread of its own, and once with null at the end.
bool _indication_proc(Instance* instance, void* client_data) noexcept
{
    const Ref<Instance> indication(instance);
    if (!indication)
        return false;
    const auto* thread_context = static_cast<CMPI_Thread_Context*>(Thread_Context::top());
    check(thread_context != nullptr, "thread_context != 0");
    const Gate_Pass pass(thread_context->gate());
    if (!pass)
        return false; // the adapter is gone

    const auto work = [&]
    {
        auto& adapter = *static_cast<CMPI_Adapter*>(client_data);
        const Auto_Mutex guard(adapter.lock);
        const auto entries = adapter.name_spaces; // a delivery may come back and change them
        for (const Name_Space_Entry& entry : entries)
            deliver(*thread_context, indication.ptr(), entry.name.c_str());
        return CMPI_RC_OK;
    };
    shielded("_indication_proc", work);
    return true;
}

// ---- on and off ----

// Runs work() while nobody else enables or disables indications. The adapter's lock, which the caller holds, is free
// meanwhile: a provider that disables joins its delivery thread, which may be waiting for that lock. A thread that works for the
// provider already cannot let go of it, or is the one to be joined: it is refused.
template <class Work> CMPIrc switch_indications(CMPI_Adapter& adapter, Work work)
{
    if (works_for(Thread_Context::top()->below(), &adapter))
    {
        ZMLR_LOG(LL_ERR, "indications not switched: the call came from within the provider");
        return CMPI_RC_ERR_FAILED;
    }
    const Auto_Unlock unlocked(adapter.lock);
    const Auto_Mutex turn(adapter.indication_switch);
    return work();
}

// A failed attempt leaves nothing enabled: the next one must not take it for done.
CMPIrc enable(CMPI_Adapter& adapter)
{
    if (adapter.indications_enabled)
        return CMPI_RC_OK;
    const Auto_Mutex guard(adapter.lock);
    const auto call = [&] { return to_rc(adapter.enable_indications(_indication_proc, &adapter)); };
    const CMPIrc rc = shielded("enable_indications", call);
    adapter.indications_enabled = rc == CMPI_RC_OK;
    return rc;
}

CMPIrc disable(CMPI_Adapter& adapter)
{
    if (!adapter.indications_enabled)
        return CMPI_RC_OK;
    const auto call = [&] { return to_rc(adapter.disable_indications()); };
    const CMPIrc rc = shielded("disable_indications", call);
    adapter.indications_enabled = false;
    return rc;
}

} // namespace

// ---- what the server calls ----

CMPIStatus CMPI_Adapter::indicationCleanup(CMPIIndicationMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept
{
    return serve_cleanup("indicationCleanup", mi, context, terminating);
}

CMPIStatus CMPI_Adapter::authorizeFilter(CMPIIndicationMI* mi, const CMPIContext*, const CMPISelectExp*, const char*,
                                         const CMPIObjectPath*, const char*) noexcept
{
    return serve_alone("authorizeFilter", mi, [](CMPI_Adapter&) { return CMPI_RC_OK; });
}

CMPIStatus CMPI_Adapter::never_poll(CMPIIndicationMI* mi) noexcept
{
    return serve_alone("mustPoll", mi, [](CMPI_Adapter&) { return CMPI_RC_OK; });
}

CMPIStatus CMPI_Adapter::activateFilter(CMPIIndicationMI* mi, const CMPIContext*, const CMPISelectExp*, const char*,
                                        const CMPIObjectPath* path, CMPIBoolean) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter)
    {
        add_filter(adapter.name_spaces, name_space_of(path));
        return CMPI_RC_OK;
    };
    return serve_alone("activateFilter", mi, work);
}

CMPIStatus CMPI_Adapter::deactivateFilter(CMPIIndicationMI* mi, const CMPIContext*, const CMPISelectExp*, const char*,
                                          const CMPIObjectPath* path, CMPIBoolean) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter)
    {
        remove_filter(adapter.name_spaces, name_space_of(path));
        return CMPI_RC_OK;
    };
    return serve_alone("deactivateFilter", mi, work);
}

CMPIStatus CMPI_Adapter::enableIndications(CMPIIndicationMI* mi, const CMPIContext* context) noexcept
{
    const auto work = [](CMPI_Adapter& adapter) { return switch_indications(adapter, [&] { return enable(adapter); }); };
    return serve("enableIndications", mi, context, work);
}

CMPIStatus CMPI_Adapter::disableIndications(CMPIIndicationMI* mi, const CMPIContext* context) noexcept
{
    const auto work = [](CMPI_Adapter& adapter) { return switch_indications(adapter, [&] { return disable(adapter); }); };
    return serve("disableIndications", mi, context, work);
}

} // namespace zmlr
