#include "cmpi/cimom.h"

namespace zmlr
{

void Instance_Enumerator::end()
{
    if (_rep)
        _context->instance_enumerator_destroy(_rep);
    _rep = nullptr;
}

int cimom::enum_instances(const char* name_space, const Instance* model, Instance_Enumerator& enumerator)
{
    enumerator.end();
    enumerator._context = Thread_Context::top();
    return enumerator._context ? enumerator._context->instance_enumerator_create(name_space, model, enumerator._rep) : -1;
}

Ref<Instance> cimom::get_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* context = Thread_Context::top();
    return context ? context->get_instance(name_space, instance) : Ref<Instance>();
}

int cimom::create_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* context = Thread_Context::top();
    return context ? context->create_instance(name_space, instance) : -1;
}

int cimom::delete_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* context = Thread_Context::top();
    return context ? context->delete_instance(name_space, instance) : -1;
}

int cimom::modify_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* context = Thread_Context::top();
    return context ? context->modify_instance(name_space, instance) : -1;
}

int cimom::invoke_method(const char* name_space, const Instance* instance, Instance* method)
{
    Thread_Context* context = Thread_Context::top();
    return context ? context->invoke_method(name_space, instance, method) : -1;
}

int cimom::allow_unload(bool flag)
{
    Thread_Context* context = Thread_Context::top();
    if (!context)
        return -1;
    context->allow_unload(flag);
    return 0;
}

bool cimom::get_username(String& user_name)
{
    Thread_Context* context = Thread_Context::top();
    return context && context->get_username(user_name);
}

} // namespace zmlr
