#include "runtime/thread_context.h"

#include "runtime/assert.h"

#include <utility>

namespace zmlr
{

namespace
{

// Needs no destructor, so that it does not keep the module from being unloaded.
constinit thread_local Thread_Context* current = nullptr;

} // namespace

void Thread_Context::push(Thread_Context* context)
{
    check(context != nullptr, "context != 0");
    context->_next = std::exchange(current, context);
}

void Thread_Context::pop()
{
    check(current != nullptr, "context != 0");
    Thread_Context* context = current;
    current = std::exchange(context->_next, nullptr);
}

Thread_Context* Thread_Context::top() { return current; }

} // namespace zmlr
