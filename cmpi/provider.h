// The base classes of providers: every operation with the answer it has until a provider overrides it.
//
// The generated skeletons (one per served class) derive from these and add the methods of the class; a provider derives
// from its skeleton and contains only what it really does. A provider sees one request at a time.
#pragma once

#include "cmpi/handlers.h"
#include "cmpi/status.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

class Provider
{
public:
    Provider() = default;
    virtual ~Provider() = default;
    Provider(const Provider&) = delete;
    Provider& operator=(const Provider&) = delete;

    virtual Load_Status load() { return LOAD_OK; }
    virtual Unload_Status unload() { return UNLOAD_OK; }
};

// An ordinary class. `model` holds the request's keys; its non-null properties are the ones that are asked for.
template <class T> class Instance_Provider : public Provider
{
public:
    using Class = T;

    // On success *instance is a new instance that the caller owns.
    virtual Get_Instance_Status get_instance([[maybe_unused]] const T* model, [[maybe_unused]] T*& instance)
    {
        return GET_INSTANCE_UNSUPPORTED;
    }
    virtual Enum_Instances_Status enum_instances([[maybe_unused]] const T* model,
                                                 [[maybe_unused]] Enum_Instances_Handler<T>& handler)
    {
        return ENUM_INSTANCES_OK;
    }
    virtual Create_Instance_Status create_instance([[maybe_unused]] T* instance) { return CREATE_INSTANCE_UNSUPPORTED; }
    virtual Delete_Instance_Status delete_instance([[maybe_unused]] const T* instance) { return DELETE_INSTANCE_UNSUPPORTED; }
    virtual Modify_Instance_Status modify_instance([[maybe_unused]] const T* model, [[maybe_unused]] const T* instance)
    {
        return MODIFY_INSTANCE_UNSUPPORTED;
    }
};

// An association class: the CMPI side answers associator and reference queries from enum_instances unless these do.
template <class T> class Association_Provider : public Instance_Provider<T>
{
public:
    virtual Enum_Associators_Status enum_associators([[maybe_unused]] const Instance* instance,
                                                     [[maybe_unused]] const String& result_class,
                                                     [[maybe_unused]] const String& role,
                                                     [[maybe_unused]] const String& result_role,
                                                     [[maybe_unused]] Enum_Associators_Handler<Instance>& handler)
    {
        return ENUM_ASSOCIATORS_UNSUPPORTED;
    }
    virtual Enum_Associator_Names_Status enum_associator_names([[maybe_unused]] const Instance* instance,
                                                               [[maybe_unused]] const String& result_class,
                                                               [[maybe_unused]] const String& role,
                                                               [[maybe_unused]] const String& result_role,
                                                               [[maybe_unused]] Enum_Associator_Names_Handler<Instance>& handler)
    {
        return ENUM_ASSOCIATOR_NAMES_UNSUPPORTED;
    }
    virtual Enum_References_Status enum_references([[maybe_unused]] const Instance* instance, [[maybe_unused]] const T* model,
                                                   [[maybe_unused]] const String& role,
                                                   [[maybe_unused]] Enum_References_Handler<T>& handler)
    {
        return ENUM_REFERENCES_UNSUPPORTED;
    }
};

// An indication class. The handler belongs to the provider from enable_indications on.
template <class T> class Indication_Provider : public Provider
{
public:
    using Class = T;

    virtual Enable_Indications_Status enable_indications(Indication_Handler<T>* handler)
    {
        delete handler;
        return ENABLE_INDICATIONS_FAILED;
    }
    virtual Disable_Indications_Status disable_indications() { return DISABLE_INDICATIONS_OK; }
};

} // namespace zmlr
