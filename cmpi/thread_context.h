// CMPI_Thread_Context: what the calling thread works in: the broker, the CMPI context of the request and the adapter.
#pragma once

#include "runtime/thread_context.h"

#include <cmpift.h>

#include <memory>

namespace zmlr
{

class CMPI_Adapter;

class CMPI_Thread_Context : public Thread_Context
{
public:
    CMPI_Thread_Context(const CMPIBroker* broker, const CMPIContext* context, CMPI_Adapter* adapter)
        : _cmpi_broker(broker)
        , _cmpi_context(context)
        , _cmpi_adapter(adapter)
    {
    }

    const CMPIBroker* cmpi_broker() const { return _cmpi_broker; }
    const CMPIContext* cmpi_context() const { return _cmpi_context; }
    CMPI_Adapter* cmpi_adapter() const { return _cmpi_adapter; }

    // There is no way back into the server yet: a new thread gets no context, and every call answers its failure.
    Thread_Context* thread_create_hook(void*) override { return nullptr; }
    void thread_start_hook() noexcept override {}
    void thread_exit_hook() noexcept override {}
    int instance_enumerator_create(const char*, const Instance*, Instance_Enumerator_Rep*&) override { return -1; }
    void instance_enumerator_destroy(Instance_Enumerator_Rep*) override {}
    bool instance_enumerator_more(const Instance_Enumerator_Rep*) override { return false; }
    void instance_enumerator_next(Instance_Enumerator_Rep*) override {}
    Ref<Instance> instance_enumerator_get(const Instance_Enumerator_Rep*) override { return {}; }
    Ref<Instance> get_instance(const char*, const Instance*) override { return {}; }
    int create_instance(const char*, const Instance*) override { return -1; }
    int delete_instance(const char*, const Instance*) override { return -1; }
    int modify_instance(const char*, const Instance*) override { return -1; }
    int invoke_method(const char*, const Instance*, Instance*) override { return -1; }
    void allow_unload(bool) override {}
    bool get_username(String&) override { return false; }

private:
    const CMPIBroker* _cmpi_broker;
    const CMPIContext* _cmpi_context;
    CMPI_Adapter* _cmpi_adapter;
};

// Puts a context on the calling thread's stack for a scope. None of the arguments may be null, and contexts pushed
// meanwhile must be gone at its end: anything else is an internal-consistency failure.
class CMPI_Thread_Context_Pusher
{
public:
    CMPI_Thread_Context_Pusher(const CMPIBroker* cmpi_broker, const CMPIContext* cmpi_context, CMPI_Adapter* cmpi_adapter);
    ~CMPI_Thread_Context_Pusher();
    CMPI_Thread_Context_Pusher(const CMPI_Thread_Context_Pusher&) = delete;
    CMPI_Thread_Context_Pusher& operator=(const CMPI_Thread_Context_Pusher&) = delete;

private:
    std::unique_ptr<CMPI_Thread_Context> _context;
};

} // namespace zmlr
