// The stack of contexts of the calling thread: through its top, provider code reaches the request it works for, and the CIM
// server behind it.
#pragma once

#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

struct Instance_Enumerator_Rep; // a running enumeration; only the context that made it knows what is in it

// What a request or a provider thread runs in. Contexts belong to one thread and are never shared.
//
// Whoever implements it answers failures by result: -1, false or a null Ref. Instances given to an operation stay the
// caller's, those returned are the caller's too; names and keys are read from the instance given.
class Thread_Context
{
public:
    Thread_Context() = default;
    Thread_Context(const Thread_Context&) = delete;
    Thread_Context& operator=(const Thread_Context&) = delete;

    static void push(Thread_Context* context); // links it above the current top; the caller keeps owning it
    static void pop();
    static Thread_Context* top(); // null when the thread has none
    const Thread_Context* below() const { return _next; }

    virtual ~Thread_Context() = default;

    // What Thread calls. The first runs in the creating thread and makes the new thread's context (deleted at that
    // thread's end; null: the thread runs without one); the others run in the new thread, first and last.
    virtual Thread_Context* thread_create_hook(void* arg) = 0;
    virtual void thread_start_hook() noexcept = 0;
    virtual void thread_exit_hook() noexcept = 0;

    // Enumerates the instances of the model's class: 0 and an enumeration that stands on the first one, or -1. A created
    // enumeration is to be destroyed by the context that created it. get() answers the current one, null after the last.
    virtual int instance_enumerator_create(const char* name_space, const Instance* model, Instance_Enumerator_Rep*& rep) = 0;
    virtual void instance_enumerator_destroy(Instance_Enumerator_Rep* rep) = 0;
    virtual bool instance_enumerator_more(const Instance_Enumerator_Rep* rep) = 0;
    virtual void instance_enumerator_next(Instance_Enumerator_Rep* rep) = 0;
    virtual Ref<Instance> instance_enumerator_get(const Instance_Enumerator_Rep* rep) = 0;

    // The server's operations: 0 or -1 (get_instance: a null Ref). `method` is a method's parameter record, whose output
    // parameters and return value are set on success.
    virtual Ref<Instance> get_instance(const char* name_space, const Instance* instance) = 0;
    virtual int create_instance(const char* name_space, const Instance* instance) = 0;
    virtual int delete_instance(const char* name_space, const Instance* instance) = 0;
    virtual int modify_instance(const char* name_space, const Instance* instance) = 0;
    virtual int invoke_method(const char* name_space, const Instance* instance, Instance* method) = 0;

    virtual void allow_unload(bool flag) = 0;        // whether the server may unload the provider
    virtual bool get_username(String& username) = 0; // who sent the request; false (and no change) when nobody tells

private:
    Thread_Context* _next = nullptr; // the one below
};

} // namespace zmlr
