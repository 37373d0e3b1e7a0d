#include "cmpi/entry.h"

#include "cmpi/cmpi_trace.h"
#include "cmpi/shell.h"
#include "cmpi/thread_context.h"
#include "runtime/log.h"

#include <atomic>

namespace zmlr
{

constinit std::recursive_mutex life_lock;

namespace
{

constexpr const char* log_source = "CMPI_Adapter";

// Counts the adapters that have gone, for factories that wait for one to.
constinit std::atomic<unsigned> departures = 0;

// Fills the record the first time only: whoever was handed it before reads it without a lock.
template <class MI, class FT> MI* hand_out(MI& mi, FT& ft, CMPI_Static_Data* sd)
{
    if (!mi.hdl)
        mi = {sd, &ft};
    return &mi;
}

// Factory calls under way on this thread: each holds the lock while it makes an adapter.
constinit thread_local unsigned factories = 0;
struct Factory_Call
{
    Factory_Call() { ++factories; }
    ~Factory_Call() { --factories; }
    Factory_Call(const Factory_Call&) = delete;
    Factory_Call& operator=(const Factory_Call&) = delete;
};

// Takes the lock when no adapter, or one that stays, is attached to the static data. Waits for one that is going, unless somebody
// waits for this thread meanwhile, who may be the one that goes: then there is no lock.
std::unique_lock<std::recursive_mutex> lock_settled(const CMPI_Static_Data* sd)
{
    for (;;)
    {
        std::unique_lock lock(life_lock);
        if (!sd->adapter || !sd->adapter->requests.is_shut())
            return lock;
        if (factories != 0 || works_for_a_leaving(Thread_Context::top()))
            return {};
        const unsigned seen = departures;
        lock.unlock();
        departures.wait(seen);
    }
}

void* interface_of(CMPI_Static_Data* sd, char kind)
{
    switch (kind)
    {
    case 'I':
        return hand_out(sd->instance_mi, sd->instance_ft, sd);
    case 'M':
        return hand_out(sd->method_mi, sd->method_ft, sd);
    case 'A':
        return hand_out(sd->association_mi, sd->association_ft, sd);
    case 'N':
        return hand_out(sd->indication_mi, sd->indication_ft, sd);
    default:
        return nullptr;
    }
}

} // namespace

CMPIrc cleanup(CMPI_Adapter* adapter, bool terminating, const Thread_Context* caller)
{
    {
        const std::lock_guard guard(life_lock);
        if (!terminating && !adapter->allow_unload)
            return CMPI_RC_DO_NOT_UNLOAD;
        if (adapter->load_count != 1)
        {
            --adapter->load_count;
            return CMPI_RC_OK;
        }
        if (works_for(caller, adapter) || factories != 0)
        {
            ZMLR_LOG(LL_ERR, "cleanup refused: it came from within the provider");
            return CMPI_RC_DO_NOT_UNLOAD;
        }
        adapter->requests.shut();
    }
    adapter->requests.wait();
    const auto unload = [&]
    {
        adapter->unload();
        return CMPI_RC_OK;
    };
    shielded("unload", unload); // the adapter goes in any case: nobody asks for the status
    adapter->broker_gate->shut();
    adapter->broker_gate->wait();

    const std::lock_guard guard(life_lock);
    delete adapter;
    ++departures;
    departures.notify_all();
    return CMPI_RC_OK;
}

} // namespace zmlr

int cimple_cmpi_adapter(char, zmlr::CMPI_Static_Data* sd, const zmlr::Registration* registration, const CMPIBroker* broker,
                        const CMPIContext* context, const char* provider_name, char kind, void** mi) noexcept
{
    using namespace zmlr;
    *mi = nullptr;
    const auto attach = [&]
    {
        const auto lock = lock_settled(sd);
        if (!lock)
        {
            ZMLR_LOG(LL_ERR, "no interface of %s: it is going, and waits for the caller", provider_name);
            return CMPI_RC_ERR_FAILED;
        }
        const Factory_Call call;
        if (sd->adapter)
            ++sd->adapter->load_count;
        else
            static_cast<void>(new CMPI_Adapter(broker, context, provider_name, registration, sd)); // kept in the static data
        ent("cimple_cmpi_adapter");
        *mi = interface_of(sd, kind);
        ret("cimple_cmpi_adapter");
        return CMPI_RC_OK;
    };
    return shielded("cimple_cmpi_adapter", attach) == CMPI_RC_OK ? 0 : -1;
}
