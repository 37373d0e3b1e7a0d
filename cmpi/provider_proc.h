// The body of every provider procedure: turns the uniform call into the typed operations of one provider class.
//
// The generated procedures call the template of their kind. `create` makes the provider object; `args` are the eight
// untyped arguments. An operation that the kind does not have answers -1.
#pragma once

#include "cmpi/provider.h"
#include "cmpi/registration.h"

namespace zmlr
{

// What providers of all kinds answer. Skeleton::invoke(skeleton, self, parameters) is the generated method dispatch: the
// provider's status, or -1 when the class has no method of the record's name.
template <class Skeleton> int common_provider_proc(int operation, Skeleton* (*create)(), void* const* args)
{
    using Class = typename Skeleton::Class;
    auto* provider = static_cast<Skeleton*>(args[0]);

    switch (operation)
    {
    case OPERATION_GET_META_CLASS:
        *static_cast<const Meta_Class**>(args[0]) = &Class::static_meta_class;
        return GET_META_CLASS_OK;
    case OPERATION_GET_REPOSITORY:
        *static_cast<const Meta_Repository**>(args[0]) = Class::static_meta_class.meta_repository;
        return GET_REPOSITORY_OK;
    case OPERATION_CREATE_PROVIDER:
        *static_cast<void**>(args[0]) = create();
        return 0;
    case OPERATION_DESTROY_PROVIDER:
        delete provider;
        return 0;
    case OPERATION_LOAD:
        return provider->load();
    case OPERATION_UNLOAD:
        return provider->unload();
    case OPERATION_INVOKE_METHOD:
        return Skeleton::invoke(*provider, static_cast<const Class*>(args[1]), static_cast<Instance*>(args[2]));
    default:
        return -1;
    }
}

template <class Skeleton> int instance_provider_proc(int operation, Skeleton* (*create)(), void* const* args)
{
    using Class = typename Skeleton::Class;
    auto* provider = static_cast<Skeleton*>(args[0]);

    switch (operation)
    {
    case OPERATION_GET_INSTANCE:
    {
        Class* found = nullptr;
        const auto status = provider->get_instance(static_cast<const Class*>(args[1]), found);
        *static_cast<Instance**>(args[2]) = found;
        return status;
    }
    case OPERATION_ENUM_INSTANCES:
    {
        const auto proc = reinterpret_cast<Enum_Instances_Proc>(args[2]);
        Enum_Instances_Handler<Class> handler(proc, args[3]);
        const auto status = provider->enum_instances(static_cast<const Class*>(args[1]), handler);
        proc(nullptr, status, args[3]);
        return status;
    }
    case OPERATION_CREATE_INSTANCE:
        return provider->create_instance(static_cast<Class*>(args[1]));
    case OPERATION_DELETE_INSTANCE:
        return provider->delete_instance(static_cast<const Class*>(args[1]));
    case OPERATION_MODIFY_INSTANCE:
        return provider->modify_instance(static_cast<const Class*>(args[1]), static_cast<const Class*>(args[2]));
    default:
        return common_provider_proc(operation, create, args);
    }
}

// With *_UNSUPPORTED the caller runs the generic fallback and marks the end itself.
template <class Skeleton> int association_provider_proc(int operation, Skeleton* (*create)(), void* const* args)
{
    using Class = typename Skeleton::Class;
    auto* provider = static_cast<Skeleton*>(args[0]);
    const auto* instance = static_cast<const Instance*>(args[1]);
    const auto string = [args](int i) -> const String& { return *static_cast<const String*>(args[i]); };

    switch (operation)
    {
    case OPERATION_ENUM_ASSOCIATOR_NAMES:
    {
        const auto proc = reinterpret_cast<Enum_Associator_Names_Proc>(args[5]);
        Enum_Associator_Names_Handler<Instance> handler(proc, args[6]);
        const auto status = provider->enum_associator_names(instance, string(2), string(3), string(4), handler);
        if (status != ENUM_ASSOCIATOR_NAMES_UNSUPPORTED)
            proc(nullptr, status, args[6]);
        return status;
    }
    case OPERATION_ENUM_ASSOCIATORS:
    {
        const auto proc = reinterpret_cast<Enum_Associators_Proc>(args[5]);
        Enum_Associators_Handler<Instance> handler(proc, args[6]);
        const auto status = provider->enum_associators(instance, string(2), string(3), string(4), handler);
        if (status != ENUM_ASSOCIATORS_UNSUPPORTED)
            proc(nullptr, status, args[6]);
        return status;
    }
    case OPERATION_ENUM_REFERENCES:
    {
        const auto proc = reinterpret_cast<Enum_References_Proc>(args[4]);
        Enum_References_Handler<Class> handler(proc, args[5]);
        const auto status = provider->enum_references(instance, static_cast<const Class*>(args[2]), string(3), handler);
        if (status != ENUM_REFERENCES_UNSUPPORTED)
            proc(nullptr, status, args[5]);
        return status;
    }
    default:
        return instance_provider_proc(operation, create, args);
    }
}

template <class Skeleton> int indication_provider_proc(int operation, Skeleton* (*create)(), void* const* args)
{
    using Class = typename Skeleton::Class;
    auto* provider = static_cast<Skeleton*>(args[0]);

    switch (operation)
    {
    case OPERATION_ENABLE_INDICATIONS:
        return provider->enable_indications(new Indication_Handler<Class>(reinterpret_cast<Indication_Proc>(args[1]), args[2]));
    case OPERATION_DISABLE_INDICATIONS:
        return provider->disable_indications();
    default:
        return common_provider_proc(operation, create, args);
    }
}

} // namespace zmlr
