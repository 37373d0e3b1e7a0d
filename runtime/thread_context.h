// The stack of contexts of the calling thread: through its top, provider code reaches the request it works for.
#pragma once

namespace zmlr
{

// What a request or a provider thread runs in. Contexts belong to one thread and are never shared.
class Thread_Context
{
public:
    Thread_Context() = default;
    virtual ~Thread_Context() = default;
    Thread_Context(const Thread_Context&) = delete;
    Thread_Context& operator=(const Thread_Context&) = delete;

    static void push(Thread_Context* context); // links it above the current top; the caller keeps owning it
    static void pop();
    static Thread_Context* top(); // null when the thread has none

private:
    Thread_Context* _next = nullptr; // the one below
};

} // namespace zmlr
