#include "cmpi/thread_context.h"

#include "runtime/assert.h"

namespace zmlr
{

CMPI_Thread_Context_Pusher::CMPI_Thread_Context_Pusher(const CMPIBroker* cmpi_broker, const CMPIContext* cmpi_context,
                                                       CMPI_Adapter* cmpi_adapter)
{
    check(cmpi_broker != nullptr, "cmpi_broker");
    check(cmpi_context != nullptr, "cmpi_context");
    check(cmpi_adapter != nullptr, "cmpi_adpater");
    _context = std::make_unique<CMPI_Thread_Context>(cmpi_broker, cmpi_context, cmpi_adapter);
    Thread_Context::push(_context.get());
}

CMPI_Thread_Context_Pusher::~CMPI_Thread_Context_Pusher()
{
    check(Thread_Context::top() == _context.get(), "Thread_Context::top() == _context");
    Thread_Context::pop();
}

} // namespace zmlr
