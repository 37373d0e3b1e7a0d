// CMPI_Thread_Context: what the calling thread works in: the broker, the CMPI context of the request and the adapter; and
// through them the calls of providers into the CIM server.
#pragma once

#include "cmpi/cmpi_objects.h"
#include "cmpi/gate.h"
#include "runtime/thread_context.h"

#include <cmpift.h>

#include <memory>

namespace zmlr
{

class CMPI_Adapter;

// A request's context borrows the request's CMPI context. A provider thread's owns one that its server made for it; such a
// thread may outlive adapter and broker: the gate that both share is shut then, and whatever would reach the server answers
// its failure. So it does for a thread that could not attach, behind a gate of its own.
class CMPI_Thread_Context : public Thread_Context
{
public:
    CMPI_Thread_Context(const CMPIBroker* broker, const CMPIContext* context, CMPI_Adapter* adapter)
        : _cmpi_broker(broker)
        , _cmpi_context(context)
        , _cmpi_adapter(adapter)
    {
    }
    ~CMPI_Thread_Context() override;

    const CMPIBroker* cmpi_broker() const { return _cmpi_broker; }
    const CMPIContext* cmpi_context() const { return _cmpi_context; }
    CMPI_Adapter* cmpi_adapter() const { return _cmpi_adapter; }
    Gate* gate() const { return _gate.get(); } // to be passed before broker or adapter are used; null for a request's

    Thread_Context* thread_create_hook(void* arg) override;
    void thread_start_hook() noexcept override;
    void thread_exit_hook() noexcept override;

    // The elements are converted to the model's class; one that is no instance ends the enumeration.
    int instance_enumerator_create(const char* name_space, const Instance* model, Instance_Enumerator_Rep*& rep) override;
    void instance_enumerator_destroy(Instance_Enumerator_Rep* rep) override;
    bool instance_enumerator_more(const Instance_Enumerator_Rep* rep) override;
    void instance_enumerator_next(Instance_Enumerator_Rep* rep) override;
    Ref<Instance> instance_enumerator_get(const Instance_Enumerator_Rep* rep) override;

    Ref<Instance> get_instance(const char* name_space, const Instance* instance) override;
    int create_instance(const char* name_space, const Instance* instance) override;
    int delete_instance(const char* name_space, const Instance* instance) override;
    int modify_instance(const char* name_space, const Instance* instance) override;
    int invoke_method(const char* name_space, const Instance* instance, Instance* method) override;

    void allow_unload(bool flag) override;
    bool get_username(String& username) override;

private:
    const CMPIBroker* _cmpi_broker;
    const CMPIContext* _cmpi_context;
    CMPI_Adapter* _cmpi_adapter;
    std::shared_ptr<Gate> _gate;
    CMPI_Ptr<CMPIContext> _prepared; // until the thread is attached: then the server frees it when the thread detaches
    bool _attached = false;
};

// Whether a context or one below it, on the calling thread's stack, works for the adapter: a request of its provider is under
// way on this thread, or the thread is the provider's own.
bool works_for(const Thread_Context* context, const CMPI_Adapter* adapter);

// Whether a context or one below it works for an adapter that is on its way out, and is waited for there.
bool works_for_a_leaving(const Thread_Context* context);

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
    CMPI_Thread_Context _context;
};

} // namespace zmlr
