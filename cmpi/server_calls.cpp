// The calls of providers into the CIM server. They run with the adapter's lock held, and the server may come straight back
// into the module on the same thread.
#include "cmpi/cmpi_containers.h"
#include "cmpi/converter.h"
#include "cmpi/thread_context.h"

#include <cmpimacs.h>

namespace zmlr
{

struct Instance_Enumerator_Rep
{
    CMPI_Ptr<CMPIEnumeration> cmpi_enumeration;
    const Meta_Class* meta_class;
    Ref<Instance> instance; // the current one; empty at the end
};

namespace
{

int answered(const CMPIStatus& status) { return okay(status) ? 0 : -1; }

// Path and CMPI instance of what a provider hands to the server; false when they cannot be made.
struct Outgoing
{
    CMPI_Ptr<CMPIObjectPath> path;
    CMPI_Ptr<CMPIInstance> instance;

    bool make_path(const CMPIBroker* broker, const char* name_space, const Instance* source)
    {
        return make_cmpi_object_path(broker, source, name_space, path) == CMPI_RC_OK;
    }
    bool make(const CMPIBroker* broker, const char* name_space, const Instance* source)
    {
        return make_path(broker, name_space, source) &&
               make_cmpi_instance(broker, share(source), name_space, path.get(), nullptr, instance) == CMPI_RC_OK;
    }
};

// Copies the outputs of one parameter record to another of the same method.
void copy_outputs(Instance* dest, const Instance* src)
{
    const Meta_Record* record = record_of(src);
    for (uint32 i = 0; i < record->num_meta_features; ++i)
    {
        const Meta_Feature* feature = record->meta_features[i];
        Value value;
        if ((feature->flags & Flag_Out) && value.borrow(src, feature) == 0)
            value.get(dest, feature);
    }
}

} // namespace

// ---- enumerations ----

int CMPI_Thread_Context::instance_enumerator_create(const char* name_space, const Instance* model, Instance_Enumerator_Rep*& rep)
{
    const Gate_Pass pass(gate());
    Outgoing outgoing;
    if (!pass || !outgoing.make_path(_cmpi_broker, name_space, model))
        return -1;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    CMPI_Ptr<CMPIEnumeration> found(CBEnumInstances(_cmpi_broker, _cmpi_context, outgoing.path.get(), nullptr, &status));
    if (!found || !okay(status))
        return -1;
    std::unique_ptr<Instance_Enumerator_Rep> made(
        new Instance_Enumerator_Rep{.cmpi_enumeration = std::move(found), .meta_class = model->meta_class, .instance = {}});
    instance_enumerator_next(made.get());
    rep = made.release();
    return 0;
}

void CMPI_Thread_Context::instance_enumerator_destroy(Instance_Enumerator_Rep* rep)
{
    const Gate_Pass pass(gate());
    const std::unique_ptr<Instance_Enumerator_Rep> last(rep);
    if (!pass)
        static_cast<void>(last->cmpi_enumeration.release());
}

bool CMPI_Thread_Context::instance_enumerator_more(const Instance_Enumerator_Rep* rep)
{
    return static_cast<bool>(rep->instance);
}

void CMPI_Thread_Context::instance_enumerator_next(Instance_Enumerator_Rep* rep)
{
    rep->instance.reset();
    const Gate_Pass pass(gate());
    const CMPIEnumeration* enumeration = rep->cmpi_enumeration.get();
    if (!pass || !CMHasNext(enumeration, nullptr))
        return;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIData element = CMGetNext(enumeration, &status);
    if (!okay(status) || element.type != CMPI_instance || !element.value.inst)
        return;
    const CMPIObjectPath* path = CMGetObjectPath(element.value.inst, nullptr);
    make_cimple_instance(_cmpi_broker, rep->meta_class, path, element.value.inst, rep->instance);
}

Ref<Instance> CMPI_Thread_Context::instance_enumerator_get(const Instance_Enumerator_Rep* rep) { return rep->instance; }

// ---- single operations ----

Ref<Instance> CMPI_Thread_Context::get_instance(const char* name_space, const Instance* instance)
{
    Ref<Instance> result;
    const Gate_Pass pass(gate());
    Outgoing outgoing;
    if (!pass || !outgoing.make_path(_cmpi_broker, name_space, instance))
        return result;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPI_Ptr<CMPIInstance> found(CBGetInstance(_cmpi_broker, _cmpi_context, outgoing.path.get(), nullptr, &status));
    if (found && okay(status))
        make_cimple_instance(_cmpi_broker, instance->meta_class, outgoing.path.get(), found.get(), result);
    return result;
}

int CMPI_Thread_Context::create_instance(const char* name_space, const Instance* instance)
{
    const Gate_Pass pass(gate());
    Outgoing outgoing;
    if (!pass || !outgoing.make(_cmpi_broker, name_space, instance))
        return -1;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPI_Ptr<CMPIObjectPath> created(
        CBCreateInstance(_cmpi_broker, _cmpi_context, outgoing.path.get(), outgoing.instance.get(), &status));
    return created ? answered(status) : -1;
}

int CMPI_Thread_Context::delete_instance(const char* name_space, const Instance* instance)
{
    const Gate_Pass pass(gate());
    Outgoing outgoing;
    if (!pass || !outgoing.make_path(_cmpi_broker, name_space, instance))
        return -1;
    return answered(CBDeleteInstance(_cmpi_broker, _cmpi_context, outgoing.path.get()));
}

int CMPI_Thread_Context::modify_instance(const char* name_space, const Instance* instance)
{
    const Gate_Pass pass(gate());
    Outgoing outgoing;
    if (!pass || !outgoing.make(_cmpi_broker, name_space, instance))
        return -1;
    return answered(CBModifyInstance(_cmpi_broker, _cmpi_context, outgoing.path.get(), outgoing.instance.get(), nullptr));
}

int CMPI_Thread_Context::invoke_method(const char* name_space, const Instance* instance, Instance* method)
{
    const Gate_Pass pass(gate());
    Outgoing outgoing;
    if (!pass || !outgoing.make_path(_cmpi_broker, name_space, instance))
        return -1;
    const CMPI_Ptr<CMPIArgs> in(CMNewArgs(_cmpi_broker, nullptr));
    const CMPI_Ptr<CMPIArgs> out(CMNewArgs(_cmpi_broker, nullptr));
    if (!in || !out)
        return -1;
    const Meta_Repository* repository = instance->meta_class->meta_repository;
    CMPIArgs_Container(repository, _cmpi_broker, name_space, in.get()).convert(method, Flag_In);

    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIData data =
        CBInvokeMethod(_cmpi_broker, _cmpi_context, outgoing.path.get(), record_of(method)->name, in.get(), out.get(), &status);
    if (!okay(status))
        return -1;

    Ref<Instance> answer(clone(method)); // the conversion begins with nulls: the inputs stay out of its way
    if (CMPIArgs_Container(repository, _cmpi_broker, name_space, out.get()).convert(nullptr, Flag_Out, answer) != 0)
        return -1;
    const Meta_Feature* return_value = record_of(method)->meta_features[record_of(method)->num_meta_features - 1];
    Value value;
    if (cmpi_to_cimple_value(repository, _cmpi_broker, name_space, data, value) == 0)
        value.get(answer.ptr(), return_value);
    copy_outputs(method, answer.ptr());
    return 0;
}

} // namespace zmlr
