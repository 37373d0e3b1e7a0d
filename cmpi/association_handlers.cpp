// The association interface of an adapter.
#include "cmpi/answer.h"
#include "cmpi/converter.h"
#include "cmpi/far_ends.h"
#include "cmpi/request.h"
#include "cmpi/status_to_rc.h"
#include "runtime/features.h"

namespace zmlr
{

namespace
{

const Meta_Class* known_class(const CMPI_Adapter& adapter, const char* name)
{
    const Meta_Repository* repository = nullptr;
    adapter.get_repository(repository);
    return find_meta_class(repository, name);
}

// Whether the association class that a request names means this provider's. Servers that pass a client's words on ask every
// provider: no name and a superclass mean the provider's own class, an unrelated one has no instances here.
CMPIrc concerns(const CMPI_Adapter& adapter, const char* class_name, bool& own)
{
    own = !class_name || !*class_name;
    if (own)
        return CMPI_RC_OK;
    const Meta_Class* named = known_class(adapter, class_name);
    own = named && is_subclass(named, adapter.mc);
    return named ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_PARAMETER;
}

// The request's answer: the provider's status first, then what became of its objects.
template <class Status> CMPIrc outcome(Status status, const Answer& answer)
{
    const CMPIrc rc = to_rc(status);
    return rc == CMPI_RC_OK ? answer.rc : rc;
}

// ---- what is sent for each object ----

const char* own_name_space(const Answer& answer, const Instance* object)
{
    return object->__name_space.empty() ? answer.name_space.c_str() : object->__name_space.c_str();
}

CMPIrc send_associator(const Answer& answer, Ref<Instance> object)
{
    CMPI_Ptr<CMPIInstance> cmpi_instance;
    const char* name_space = own_name_space(answer, object.ptr());
    if (make_cmpi_instance(answer.broker, std::move(object), name_space, nullptr, answer.properties, cmpi_instance) != CMPI_RC_OK)
        return CMPI_RC_ERR_FAILED;
    CMReturnInstance(answer.result, cmpi_instance.get());
    return CMPI_RC_OK;
}

CMPIrc make_name(const Answer& answer, const Instance* object, CMPI_Ptr<CMPIObjectPath>& path)
{
    return make_cmpi_object_path(answer.broker, object, own_name_space(answer, object), path);
}

CMPIrc send_name(const Answer& answer, Ref<Instance> object)
{
    CMPI_Ptr<CMPIObjectPath> path;
    if (make_name(answer, object.ptr(), path) != CMPI_RC_OK)
        return CMPI_RC_ERR_FAILED;
    CMReturnObjectPath(answer.result, path.get());
    return CMPI_RC_OK;
}

// An answer has each far end once, however many associations lead to it: a repeated one is not worth another fetch, which may ask
// the drivers. (Names cost nothing; servers drop those that are repeated, also across providers.)
CMPIrc send_named_instance(const Answer& answer, Ref<Instance> object)
{
    if (!answer.far_ends->add(object.ptr()))
        return CMPI_RC_OK;
    CMPI_Ptr<CMPIObjectPath> path;
    if (make_name(answer, object.ptr(), path) != CMPI_RC_OK)
        return CMPI_RC_ERR_FAILED;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPI_Ptr<CMPIInstance> found(
        CBGetInstance(answer.broker, answer.context, path.get(), answer.properties.names(), &status));
    if (!found || !okay(status))
        return CMPI_RC_ERR_FAILED;
    CMReturnInstance(answer.result, found.get());
    return CMPI_RC_OK;
}

bool listed(const char* name, const char** properties)
{
    while (*properties && !eqi(*properties, name))
        ++properties;
    return *properties != nullptr;
}

// With a list, what it names stays and every key is left to the path. filter_properties would make what is wanted non-null: that
// is for models; an association's null property must not get a value.
void keep_listed(Instance* association, const char** properties)
{
    if (!properties)
        return;
    for (const Meta_Feature* feature : features_of(association))
        if (is_property(feature) && (is_key(feature) || !listed(feature->name, properties)))
            null_of(association, as_property(feature)) = 1;
}

CMPIrc send_reference(const Answer& answer, Ref<Instance> association)
{
    CMPI_Ptr<CMPIObjectPath> path;
    CMPIrc rc = make_cmpi_object_path(answer.broker, association.ptr(), answer.name_space.c_str(), path);
    if (rc != CMPI_RC_OK)
        return rc;
    keep_listed(association.ptr(), answer.properties.names()); // after the path, which needs the keys

    CMPI_Ptr<CMPIInstance> cmpi_instance;
    rc = make_cmpi_instance(answer.broker, std::move(association), answer.name_space.c_str(), path.get(), answer.properties,
                            cmpi_instance);
    if (rc == CMPI_RC_OK)
        CMReturnInstance(answer.result, cmpi_instance.get());
    return rc;
}

CMPIrc send_reference_name(const Answer& answer, Ref<Instance> association)
{
    nullify_non_keys(association.ptr());
    CMPI_Ptr<CMPIObjectPath> path;
    const CMPIrc rc = make_cmpi_object_path(answer.broker, association.ptr(), answer.name_space.c_str(), path);
    if (rc == CMPI_RC_OK)
        CMReturnObjectPath(answer.result, path.get());
    return rc;
}

// ---- the requests ----

struct Association_Request
{
    CMPI_Adapter& adapter;
    const CMPIContext* context;
    const CMPIResult* result;
    const CMPIObjectPath* path; // of the source
    const char* association_class;
    String result_class = {};
    String role = {};
    String result_role = {};
    const char** properties = nullptr;

    Answer answer() const
    {
        return {.broker = adapter.broker,
                .context = context,
                .result = result,
                .name_space = name_space_of(path),
                .properties = properties};
    }
    const Meta_Class* source_class() const { return known_class(adapter, class_name_of(path).c_str()); }
};

CMPIrc answer_associators(const Association_Request& request)
{
    bool own = false;
    CMPIrc rc = concerns(request.adapter, request.association_class, own);
    const Meta_Class* source_class = own ? request.source_class() : nullptr;
    if (!source_class)
        return rc;
    Ref<Instance> source;
    rc = make_cimple_reference(request.adapter.broker, source_class, request.path, source);
    if (rc != CMPI_RC_OK)
        return rc;

    Answer answer = request.answer();
    const auto status = request.adapter.enum_associators(source.ptr(), request.result_class, request.role, request.result_role,
                                                         answer_with<send_associator>, &answer);
    if (status != ENUM_ASSOCIATORS_UNSUPPORTED)
        return outcome(status, answer);
    Far_Ends far_ends;
    answer.far_ends = &far_ends;
    return outcome(request.adapter.enum_associator_names(source.ptr(), request.result_class, request.role, request.result_role,
                                                         answer_with<send_named_instance>, &answer),
                   answer);
}

CMPIrc answer_associator_names(const Association_Request& request)
{
    bool own = false;
    CMPIrc rc = concerns(request.adapter, request.association_class, own);
    if (!own)
        return rc;
    const Meta_Class* source_class = request.source_class();
    if (!source_class)
        return CMPI_RC_ERR_INVALID_CLASS;
    Ref<Instance> source;
    rc = make_cimple_reference(request.adapter.broker, source_class, request.path, source);
    if (rc != CMPI_RC_OK)
        return rc;

    Answer answer = request.answer();
    return outcome(request.adapter.enum_associator_names(source.ptr(), request.result_class, request.role, request.result_role,
                                                         answer_with<send_name>, &answer),
                   answer);
}

// References and their names: the model tells which properties the caller wants of the associations.
template <Send send> CMPIrc answer_references(const Association_Request& request, void (*prepare_model)(Instance*))
{
    const Meta_Class* source_class = request.source_class();
    if (!source_class)
        return CMPI_RC_ERR_INVALID_CLASS;
    bool own = false;
    CMPIrc rc = concerns(request.adapter, request.association_class, own);
    if (!own)
        return rc;
    Ref<Instance> source;
    rc = make_cimple_reference(request.adapter.broker, source_class, request.path, source);
    if (rc != CMPI_RC_OK)
        return rc;

    const Ref<Instance> model(create(request.adapter.mc, false));
    prepare_model(model.ptr());
    Answer answer = request.answer();
    return outcome(request.adapter.enum_references(source.ptr(), model.ptr(), request.role, answer_with<send>, &answer), answer);
}

} // namespace

// ---- what the server calls ----

// The one cleanup that runs without a thread context.
CMPIStatus CMPI_Adapter::associationCleanup(CMPIAssociationMI* mi, const CMPIContext*, CMPIBoolean terminating) noexcept
{
    constexpr const char* name = "associationCleanup";
    return {shielded(name, [&] { return traced_cleanup(name, leaving(mi), terminating, Thread_Context::top()); }), nullptr};
}

CMPIStatus CMPI_Adapter::associators(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                     const CMPIObjectPath* path, const char* assoc_class, const char* result_class,
                                     const char* role, const char* result_role, const char** properties) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) {
        return answer_associators({adapter, context, result, path, assoc_class, result_class, role, result_role, properties});
    };
    return serve("associators", mi, context, work);
}

CMPIStatus CMPI_Adapter::associatorNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                         const CMPIObjectPath* path, const char* assoc_class, const char* result_class,
                                         const char* role, const char* result_role) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter) {
        return answer_associator_names({adapter, context, result, path, assoc_class, result_class, role, result_role});
    };
    return serve("associatorNames", mi, context, work);
}

CMPIStatus CMPI_Adapter::references(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                    const CMPIObjectPath* path, const char* result_class, const char* role,
                                    const char** properties) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter)
    {
        const auto whole = [](Instance*) {};
        return answer_references<send_reference>({.adapter = adapter,
                                                  .context = context,
                                                  .result = result,
                                                  .path = path,
                                                  .association_class = result_class,
                                                  .role = role,
                                                  .properties = properties},
                                                 whole);
    };
    return serve("references", mi, context, work);
}

CMPIStatus CMPI_Adapter::referenceNames(CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
                                        const CMPIObjectPath* path, const char* result_class, const char* role) noexcept
{
    const auto work = [&](CMPI_Adapter& adapter)
    {
        return answer_references<send_reference_name>({.adapter = adapter,
                                                       .context = context,
                                                       .result = result,
                                                       .path = path,
                                                       .association_class = result_class,
                                                       .role = role},
                                                      nullify_non_keys);
    };
    return serve("referenceNames", mi, context, work);
}

} // namespace zmlr
