// Provider_Handle: the caller's view of one provider object. It makes the object, calls its operations through the provider
// procedure, and answers what the provider leaves unsupported from the provider's own enumeration.
//
// Instances given in are borrowed. Instances that a callback receives belong to it. A callback may throw: the exception
// passes through and nothing is lost on the way. Operations that the provider's class does not have answer a status
// outside their enumeration (the procedure's -1).
#pragma once

#include "cmpi/handlers.h"
#include "cmpi/registration.h"
#include "cmpi/status.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

class Provider_Handle
{
public:
    // Makes the provider object, which lives as long as the handle.
    explicit Provider_Handle(const Registration* registration);
    ~Provider_Handle();
    Provider_Handle(const Provider_Handle&) = delete;
    Provider_Handle& operator=(const Provider_Handle&) = delete;

    Get_Meta_Class_Status get_meta_class(const Meta_Class*& meta_class) const;
    Get_Repository_Status get_repository(const Meta_Repository*& repository) const;
    Load_Status load();
    Unload_Status unload();

    // The instance with the model's keys. Where the provider does not answer itself it is the first enumerated one with
    // equal keys, or GET_INSTANCE_NOT_FOUND. `found` is set on GET_INSTANCE_OK only.
    Get_Instance_Status get_instance(const Instance* model, Ref<Instance>& found);

    // Every enumeration ends with one call of the callback for a null instance, whatever its outcome.
    Enum_Instances_Status enum_instances(const Instance* model, Enum_Instances_Proc proc, void* client_data);

    Create_Instance_Status create_instance(Instance* instance);
    Delete_Instance_Status delete_instance(const Instance* instance);
    Modify_Instance_Status modify_instance(const Instance* model, const Instance* instance);

    // `method` is the parameter record of the method to call: its outputs and "return_value" are filled in.
    Invoke_Method_Status invoke_method(const Instance* instance, Instance* method);

    Enable_Indications_Status enable_indications(Indication_Proc proc, void* client_data);
    Disable_Indications_Status disable_indications();

    // The far ends of the associations that concern `instance`; an empty text means any class or role. Without an answer of
    // the provider enum_associators is ENUM_ASSOCIATORS_UNSUPPORTED, without an end mark.
    Enum_Associators_Status enum_associators(const Instance* instance, const String& result_class, const String& role,
                                             const String& result_role, Enum_Associators_Proc proc, void* client_data);

    // These two answer from the enumerated associations where the provider does not. A class that is no association fails
    // before the provider is asked, without an end mark.
    Enum_Associator_Names_Status enum_associator_names(const Instance* instance, const String& result_class, const String& role,
                                                       const String& result_role, Enum_Associator_Names_Proc proc,
                                                       void* client_data);
    Enum_References_Status enum_references(const Instance* instance, const Instance* model, const String& role,
                                           Enum_References_Proc proc, void* client_data);

private:
    const Meta_Class* association_class() const; // null when the class is none

    const Registration* _registration;
    Provider_Proc _proc;
    void* _provider = nullptr;
};

} // namespace zmlr
