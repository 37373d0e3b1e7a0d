// The frame of every request handler: adapter, thread context, lock, traces, and the shell that keeps exceptions in.
#pragma once

#include "cmpi/adapter.h"
#include "cmpi/cmpi_trace.h"
#include "cmpi/entry.h"
#include "cmpi/shell.h"
#include "cmpi/thread_context.h"

namespace zmlr
{

// Runs work(adapter), which answers a CMPIrc, traced and under the adapter's lock.
template <class Work> CMPIrc locked(const char* name, CMPI_Adapter* adapter, Work work)
{
    const Auto_Mutex guard(adapter->lock);
    ent(name);
    const CMPIrc answer = shielded(name, [&] { return work(*adapter); });
    ret(name, answer);
    return answer;
}

// Runs work(adapter) as the handler `name` of the interface. A request that comes when the adapter is going fails.
template <class MI, class Work> CMPIStatus serve(const char* name, MI* mi, const CMPIContext* context, Work work) noexcept
{
    const auto request = [&]
    {
        const Adapter_Use use(mi);
        CMPI_Adapter* adapter = use.adapter();
        if (!adapter)
            return CMPI_RC_ERR_FAILED;
        const CMPI_Thread_Context_Pusher pusher(adapter->broker, context, adapter);
        return locked(name, adapter, work);
    };
    return {shielded(name, request), nullptr};
}

// The same without a thread context, for what never reaches the provider.
template <class MI, class Work> CMPIStatus serve_alone(const char* name, MI* mi, Work work) noexcept
{
    const auto request = [&]
    {
        const Adapter_Use use(mi);
        return use.adapter() ? locked(name, use.adapter(), work) : CMPI_RC_ERR_FAILED;
    };
    return {shielded(name, request), nullptr};
}

// The adapter of an interface that is given up: it stays until it is.
template <class MI> CMPI_Adapter* leaving(MI* mi)
{
    const std::lock_guard guard(life_lock);
    return CMPI_Adapter::of(mi);
}

// The common cleanup, traced as the cleanup function `name`. The adapter's lock is not taken: the adapter may end here, and a
// provider that unloads may wait for a thread that needs it.
inline CMPIrc traced_cleanup(const char* name, CMPI_Adapter* adapter, CMPIBoolean terminating, const Thread_Context* caller)
{
    ent(name);
    const CMPIrc answer = cleanup(adapter, terminating != 0, caller);
    ret(name, answer);
    return answer;
}

// Runs the common cleanup as the cleanup function `name` of the interface, under a thread context.
template <class MI>
CMPIStatus serve_cleanup(const char* name, MI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept
{
    const auto request = [&]
    {
        CMPI_Adapter* adapter = leaving(mi);
        const Thread_Context* caller = Thread_Context::top();
        const CMPI_Thread_Context_Pusher pusher(adapter->broker, context, adapter);
        return traced_cleanup(name, adapter, terminating, caller);
    };
    return {shielded(name, request), nullptr};
}

} // namespace zmlr
