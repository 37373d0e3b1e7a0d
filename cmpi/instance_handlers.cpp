// The instance interface of an adapter.
#include "cmpi/answer.h"
#include "cmpi/cmpi_objects.h"
#include "cmpi/converter.h"
#include "cmpi/request.h"
#include "cmpi/status_to_rc.h"

namespace zmlr
{

namespace
{

CMPIrc send_path(const Answer& answer, Ref<Instance> object)
{
    CMPI_Ptr<CMPIObjectPath> path;
    const CMPIrc rc = make_cmpi_object_path(answer.broker, object.ptr(), answer.name_space.c_str(), path);
    if (rc == CMPI_RC_OK)
        CMReturnObjectPath(answer.result, path.get());
    return rc;
}

CMPIrc send_instance(const Answer& answer, Ref<Instance> object)
{
    CMPI_Ptr<CMPIInstance> cmpi_instance;
    const CMPIrc rc =
        make_cmpi_object(answer.broker, std::move(object), answer.name_space.c_str(), answer.properties, cmpi_instance);
    if (rc == CMPI_RC_OK)
        CMReturnInstance(answer.result, cmpi_instance.get());
    return rc;
}

// An instance with the keys of the request's path. Its class is the requested one.
CMPIrc make_model(const CMPI_Adapter& adapter, const CMPIObjectPath* path, Ref<Instance>& model)
{
    const Meta_Class* meta_class = adapter.requested_class(path);
    return meta_class ? make_cimple_reference(adapter.broker, meta_class, path, model) : CMPI_RC_ERR_FAILED;
}

CMPIrc make_instance(const CMPI_Adapter& adapter, const CMPIObjectPath* path, const CMPIInstance* cmpi_instance,
                     Ref<Instance>& instance)
{
    const Meta_Class* meta_class = adapter.requested_class(path);
    return meta_class ? make_cimple_instance(adapter.broker, meta_class, path, cmpi_instance, instance) : CMPI_RC_ERR_FAILED;
}

// ---- the requests ----

CMPIrc enumerate_names(CMPI_Adapter& adapter, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path)
{
    Ref<Instance> model;
    CMPIrc rc = make_model(adapter, path, model);
    if (rc != CMPI_RC_OK)
        return rc;

    Answer answer{.broker = adapter.broker, .context = context, .result = result, .name_space = model->__name_space};
    const auto status = adapter.enum_instances(model.ptr(), answer_with<send_path>, &answer);
    rc = to_rc(status);
    if (rc == CMPI_RC_OK)
        rc = answer.rc;
    if (rc == CMPI_RC_OK && status == ENUM_INSTANCES_OK)
        CMReturnDone(result);
    return rc;
}

CMPIrc enumerate(CMPI_Adapter& adapter, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path,
                 const char** properties)
{
    Ref<Instance> model;
    CMPIrc rc = make_model(adapter, path, model);
    if (rc != CMPI_RC_OK)
        return rc;
    if (properties)
    {
        __set_null_flags(model.ptr(), true, false, 0); // keys are always wanted, also where the path has none
        filter_properties(model.ptr(), properties, true);
    }

    Answer answer{.broker = adapter.broker,
                  .context = context,
                  .result = result,
                  .name_space = model->__name_space,
                  .properties = properties};
    rc = to_rc(adapter.enum_instances(model.ptr(), answer_with<send_instance>, &answer));
    if (rc == CMPI_RC_OK)
        rc = answer.rc;
    if (rc == CMPI_RC_OK)
        CMReturnDone(result);
    return rc;
}

CMPIrc get(CMPI_Adapter& adapter, const CMPIResult* result, const CMPIObjectPath* path, const char** properties)
{
    Ref<Instance> model;
    CMPIrc rc = make_model(adapter, path, model);
    if (rc != CMPI_RC_OK)
        return rc;
    de_nullify_properties(model.ptr());
    filter_properties(model.ptr(), properties, true);

    Ref<Instance> found;
    rc = to_rc(adapter.get_instance(model.ptr(), found));
    if (rc != CMPI_RC_OK)
        return rc;
    if (!found)
        return CMPI_RC_ERR_FAILED;

    CMPI_Ptr<CMPIInstance> cmpi_instance;
    const String name_space = model->__name_space;
    model.reset();
    rc = make_cmpi_instance(adapter.broker, std::move(found), name_space.c_str(), path, properties, cmpi_instance);
    if (rc != CMPI_RC_OK)
        return rc;
    CMReturnInstance(result, cmpi_instance.get());
    CMReturnDone(result);
    return CMPI_RC_OK;
}

CMPIrc create_new(CMPI_Adapter& adapter, const CMPIResult* result, const CMPIObjectPath* path, const CMPIInstance* cmpi_instance)
{
    Ref<Instance> instance;
    CMPIrc rc = make_instance(adapter, path, cmpi_instance, instance);
    if (rc != CMPI_RC_OK)
        return rc;
    const auto status = adapter.create_instance(instance.ptr());
    if (status != CREATE_INSTANCE_OK)
        return to_rc(status);

    CMPI_Ptr<CMPIObjectPath> created;
    rc = make_cmpi_object_path(adapter.broker, instance.ptr(), name_space_of(path).c_str(), created);
    if (rc != CMPI_RC_OK)
        return rc;
    CMReturnObjectPath(result, created.get());
    CMReturnDone(result);
    return CMPI_RC_OK;
}

CMPIrc modify(CMPI_Adapter& adapter, const CMPIResult* result, const CMPIObjectPath* path, const CMPIInstance* cmpi_instance,
              const char** properties)
{
    Ref<Instance> instance;
    const CMPIrc rc = make_instance(adapter, path, cmpi_instance, instance);
    if (rc != CMPI_RC_OK)
        return rc;
    const Ref<Instance> model(clone(instance.ptr()));
    filter_properties(model.ptr(), properties, true);
    const auto status = adapter.modify_instance(model.ptr(), instance.ptr());
    if (status != MODIFY_INSTANCE_OK)
        return to_rc(status);
    CMReturnObjectPath(result, path);
    CMReturnDone(result);
    return CMPI_RC_OK;
}

CMPIrc remove(CMPI_Adapter& adapter, const CMPIResult* result, const CMPIObjectPath* path)
{
    Ref<Instance> instance;
    CMPIrc rc = make_model(adapter, path, instance);
    if (rc != CMPI_RC_OK)
        return rc;
    rc = to_rc(adapter.delete_instance(instance.ptr()));
    if (rc == CMPI_RC_OK)
        CMReturnDone(result);
    return rc;
}

} // namespace

// ---- what the server calls ----

CMPIStatus CMPI_Adapter::instanceCleanup(CMPIInstanceMI* mi, const CMPIContext* context, CMPIBoolean terminating) noexcept
{
    return serve_cleanup("instanceCleanup", mi, context, terminating);
}

CMPIStatus CMPI_Adapter::enumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                           const CMPIObjectPath* path) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return enumerate_names(adapter, context, result, path); };
    return serve("enumInstanceNames", mi, context, work);
}

CMPIStatus CMPI_Adapter::enumInstances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                       const CMPIObjectPath* path, const char** properties) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return enumerate(adapter, context, result, path, properties); };
    return serve("enumInstances", mi, context, work);
}

CMPIStatus CMPI_Adapter::getInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path, const char** properties) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return get(adapter, result, path, properties); };
    return serve("getInstance", mi, context, work);
}

CMPIStatus CMPI_Adapter::createInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path, const CMPIInstance* cmpi_instance) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return create_new(adapter, result, path, cmpi_instance); };
    return serve("createInstance", mi, context, work);
}

CMPIStatus CMPI_Adapter::modifyInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path, const CMPIInstance* cmpi_instance,
                                        const char** properties) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return modify(adapter, result, path, cmpi_instance, properties); };
    return serve("modifyInstance", mi, context, work);
}

CMPIStatus CMPI_Adapter::deleteInstance(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) { return remove(adapter, result, path); };
    return serve("deleteInstance", mi, context, work);
}

CMPIStatus CMPI_Adapter::execQuery(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult*, const CMPIObjectPath*,
                                   const char*, const char*) noexcept
{
    return serve("execQuery", mi, context, [](CMPI_Adapter&) { return CMPI_RC_ERR_NOT_SUPPORTED; });
}

} // namespace zmlr
