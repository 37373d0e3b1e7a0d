// cimom: the CIM server as providers see it: the calls back into it, for the request (or the provider thread) that the
// calling thread works for.
//
// Everything answers its failure (-1, false, a null Ref) on a thread without a context. Instances and name spaces given stay
// the caller's. A call may come straight back into the module on the same thread.
#pragma once

#include "runtime/thread_context.h"

namespace zmlr
{

// A running enumeration of the server's instances. It belongs to the thread that began it.
//
//     Instance_Enumerator e;
//     if (cimom::enum_instances("root/PG_InterOp", model, e) == 0)
//         for (; e; ++e)
//             use(e());
class Instance_Enumerator
{
public:
    Instance_Enumerator() = default;
    ~Instance_Enumerator() { end(); }
    Instance_Enumerator(const Instance_Enumerator&) = delete;
    Instance_Enumerator& operator=(const Instance_Enumerator&) = delete;

    explicit operator bool() const { return _rep && _context->instance_enumerator_more(_rep); } // there is a current instance
    void operator++() { _context->instance_enumerator_next(_rep); }                             // while there is one
    Ref<Instance> operator()() const { return _context->instance_enumerator_get(_rep); }        // while there is one

private:
    friend class cimom;

    void end();

    Thread_Context* _context = nullptr; // the one that made the enumeration
    Instance_Enumerator_Rep* _rep = nullptr;
};

class cimom
{
public:
    // Enumerates the instances of the model's class as instances of that class.
    static int enum_instances(const char* name_space, const Instance* model, Instance_Enumerator& enumerator);

    static Ref<Instance> get_instance(const char* name_space, const Instance* instance);
    static int create_instance(const char* name_space, const Instance* instance);
    static int delete_instance(const char* name_space, const Instance* instance);
    static int modify_instance(const char* name_space, const Instance* instance);

    // `method` is the parameter record: its outputs and its return value are set on success.
    static int invoke_method(const char* name_space, const Instance* instance, Instance* method);

    static int allow_unload(bool flag);          // whether the server may unload the calling provider
    static bool get_username(String& user_name); // who sent the request
};

} // namespace zmlr
