#include "cmpi/thread_context.h"

#include "cmpi/adapter.h"
#include "cmpi/cmpi_trace.h"
#include "cmpi/shell.h"
#include "runtime/assert.h"
#include "runtime/log.h"

#include <cmpimacs.h>

#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "CMPI_Thread_Context";

// The calling thread's context, as the thread hooks need it.
CMPI_Thread_Context* complete_top()
{
    auto* context = static_cast<CMPI_Thread_Context*>(Thread_Context::top());
    check(context != nullptr, "context != 0");
    check(context->cmpi_broker() != nullptr, "context->cmpi_broker() != 0");
    check(context->cmpi_context() != nullptr, "context->cmpi_context() != 0");
    return context;
}

} // namespace

// A context that its server prepared and whose thread never attached.
CMPI_Thread_Context::~CMPI_Thread_Context()
{
    const Gate_Pass pass(gate());
    if (!pass)
        static_cast<void>(_prepared.release());
    _prepared.reset();
}

Thread_Context* CMPI_Thread_Context::thread_create_hook(void*)
{
    const CMPI_Thread_Context* creator = complete_top();
    const Gate_Pass pass(creator->gate());
    if (!pass)
        return nullptr;
    CMPI_Adapter* adapter = creator->cmpi_adapter();
    CMPI_Ptr<CMPIContext> cmpi_context(CBPrepareAttachThread(creator->cmpi_broker(), creator->cmpi_context()));
    check(cmpi_context != nullptr, "cmpi_context != 0");

    auto context = std::make_unique<CMPI_Thread_Context>(creator->cmpi_broker(), cmpi_context.get(), adapter);
    context->_gate = adapter->broker_gate;
    context->_prepared = std::move(cmpi_context);
    return context.release();
}

// A thread that the server does not let in leaves the broker alone: what it made there would belong to nobody.
void CMPI_Thread_Context::thread_start_hook() noexcept
{
    const auto attach = [&]
    {
        complete_top();
        const std::shared_ptr<Gate> open = _gate;
        const Gate_Pass pass(open.get());
        if (!pass)
            return CMPI_RC_OK;
        const auto call = [&] { return CBAttachThread(_cmpi_broker, _cmpi_context).rc; };
        const CMPIrc rc = shielded("CBAttachThread", call);
        _attached = rc == CMPI_RC_OK;
        if (_attached)
        {
            static_cast<void>(_prepared.release());
            return rc;
        }
        ZMLR_LOG(LL_ERR, "CBAttachThread() failed: %s", _rc_to_str(rc));
        _gate = std::make_shared<Gate>();
        _gate->shut();
        _prepared.reset();
        return rc;
    };
    shielded("thread_start_hook", attach);
}

void CMPI_Thread_Context::thread_exit_hook() noexcept
{
    const auto detach = [&]
    {
        complete_top();
        const Gate_Pass pass(gate());
        if (pass && std::exchange(_attached, false))
            CBDetachThread(_cmpi_broker, _cmpi_context);
        return CMPI_RC_OK;
    };
    shielded("thread_exit_hook", detach);
}

void CMPI_Thread_Context::allow_unload(bool flag)
{
    check(_cmpi_adapter != nullptr, "_cmpi_adapter != 0");
    const Gate_Pass pass(gate());
    if (pass)
        _cmpi_adapter->allow_unload = flag;
}

bool CMPI_Thread_Context::get_username(String& username)
{
    const Gate_Pass pass(gate());
    if (!pass)
        return false;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIData entry = CMGetContextEntry(_cmpi_context, CMPIPrincipal, &status);
    const char* text = okay(status) && entry.type == CMPI_string ? chars_of(entry.value.string) : nullptr;
    if (!text)
    {
        ZMLR_LOG(LL_ERR, "username not OK cmpirc=%d", static_cast<int>(status.rc));
        return false;
    }
    username = text;
    return true;
}

bool works_for(const Thread_Context* context, const CMPI_Adapter* adapter)
{
    while (context && static_cast<const CMPI_Thread_Context*>(context)->cmpi_adapter() != adapter)
        context = context->below();
    return context != nullptr;
}

bool works_for_a_leaving(const Thread_Context* context)
{
    for (; context; context = context->below())
    {
        const auto* cmpi_context = static_cast<const CMPI_Thread_Context*>(context);
        const Gate_Pass pass(cmpi_context->gate()); // a provider thread's adapter may be gone
        if (pass && cmpi_context->cmpi_adapter()->requests.is_shut())
            return true;
    }
    return false;
}

CMPI_Thread_Context_Pusher::CMPI_Thread_Context_Pusher(const CMPIBroker* cmpi_broker, const CMPIContext* cmpi_context,
                                                       CMPI_Adapter* cmpi_adapter)
    : _context(cmpi_broker, cmpi_context, cmpi_adapter)
{
    check(cmpi_broker != nullptr, "cmpi_broker");
    check(cmpi_context != nullptr, "cmpi_context");
    check(cmpi_adapter != nullptr, "cmpi_adpater");
    Thread_Context::push(&_context);
}

CMPI_Thread_Context_Pusher::~CMPI_Thread_Context_Pusher()
{
    check(Thread_Context::top() == &_context, "Thread_Context::top() == _context");
    Thread_Context::pop();
}

} // namespace zmlr
