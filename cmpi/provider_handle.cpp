#include "cmpi/provider_handle.h"

#include <array>
#include <utility>
#include <vector>

namespace zmlr
{

namespace
{

// The procedure's arguments are untyped: constness and types are what its table of operations says.
void* untyped(const void* pointer) { return const_cast<void*>(pointer); }
template <class... Parameters> void* untyped(bool (*callback)(Parameters...)) { return reinterpret_cast<void*>(callback); }

template <class... Arguments>
int call(Provider_Proc proc, const Registration* registration, Operation operation, Arguments... arguments)
{
    const std::array<void*, 8> a = {untyped(arguments)...};
    return proc(registration, operation, a[0], a[1], a[2], a[3], a[4], a[5], a[6], a[7]);
}

// ---- get_instance from an enumeration ----

struct Key_Search
{
    const Instance* model;
    Ref<Instance> found;
};

bool keep_first_match(Instance* instance, Enum_Instances_Status, void* client_data)
{
    Ref<Instance> candidate(instance);
    auto& search = *static_cast<Key_Search*>(client_data);
    if (!candidate || search.found)
        return false;
    if (!key_eq(candidate.ptr(), search.model))
        return true;
    search.found = std::move(candidate);
    return false;
}

// ---- associator names and references from an enumeration of the association ----

struct Associator_Names_Args
{
    const Instance* instance;
    const String& result_class;
    const String& role;
    const String& result_role;
    Enum_Associator_Names_Proc proc;
    void* client_data;
    std::vector<const Instance*> far_ends;
    bool stopped = false;
};

bool pass_on_far_ends(Instance* instance, Enum_Instances_Status, void* client_data)
{
    const Ref<Instance> association(instance);
    auto& args = *static_cast<Associator_Names_Args*>(client_data);
    if (!association || args.stopped)
        return false;

    args.far_ends.resize(association->meta_class->num_meta_features);
    const int count = get_associators(args.instance, association.ptr(), args.result_class.c_str(), args.role.c_str(),
                                      args.result_role.c_str(), args.far_ends.data());
    for (int i = 0; i < count && !args.stopped; ++i)
    {
        const Instance* name = args.far_ends[static_cast<std::size_t>(i)];
        args.stopped = !args.proc(share(name).steal(), ENUM_ASSOCIATOR_NAMES_OK, args.client_data);
    }
    return !args.stopped;
}

struct References_Args
{
    const Instance* instance;
    const String& role;
    Enum_References_Proc proc;
    void* client_data;
    bool stopped = false;
};

bool pass_on_reference(Instance* instance, Enum_Instances_Status, void* client_data)
{
    Ref<Instance> association(instance);
    auto& args = *static_cast<References_Args*>(client_data);
    if (!association || args.stopped)
        return false;
    if (!is_reference_of(args.instance, association.ptr(), args.role.c_str()))
        return true;
    args.stopped = !args.proc(association.steal(), ENUM_REFERENCES_OK, args.client_data);
    return !args.stopped;
}

// The status of an answer that was made of an enumeration.
template <auto ok, auto failed, auto denied> auto made_of(Enum_Instances_Status status)
{
    switch (status)
    {
    case ENUM_INSTANCES_FAILED:
        return failed;
    case ENUM_INSTANCES_ACCESS_DENIED:
        return denied;
    default:
        return ok;
    }
}

} // namespace

Provider_Handle::Provider_Handle(const Registration* registration)
    : _registration(registration)
    , _proc(registration->provider_proc)
{
    call(_proc, _registration, OPERATION_CREATE_PROVIDER, &_provider);
}

Provider_Handle::~Provider_Handle() { call(_proc, _registration, OPERATION_DESTROY_PROVIDER, _provider); }

Get_Meta_Class_Status Provider_Handle::get_meta_class(const Meta_Class*& meta_class) const
{
    return static_cast<Get_Meta_Class_Status>(call(_proc, _registration, OPERATION_GET_META_CLASS, &meta_class));
}

Get_Repository_Status Provider_Handle::get_repository(const Meta_Repository*& repository) const
{
    return static_cast<Get_Repository_Status>(call(_proc, _registration, OPERATION_GET_REPOSITORY, &repository));
}

Load_Status Provider_Handle::load() { return static_cast<Load_Status>(call(_proc, _registration, OPERATION_LOAD, _provider)); }

Unload_Status Provider_Handle::unload()
{
    return static_cast<Unload_Status>(call(_proc, _registration, OPERATION_UNLOAD, _provider));
}

Get_Instance_Status Provider_Handle::get_instance(const Instance* model, Ref<Instance>& found)
{
    Instance* instance = nullptr;
    const auto status =
        static_cast<Get_Instance_Status>(call(_proc, _registration, OPERATION_GET_INSTANCE, _provider, model, &instance));
    Ref<Instance> answer(instance);
    if (status != GET_INSTANCE_UNSUPPORTED)
    {
        if (status == GET_INSTANCE_OK)
            found = std::move(answer);
        return status;
    }

    Key_Search search{.model = model, .found = {}};
    if (enum_instances(model, keep_first_match, &search) != ENUM_INSTANCES_OK || !search.found)
        return GET_INSTANCE_NOT_FOUND;
    found = std::move(search.found);
    return GET_INSTANCE_OK;
}

Enum_Instances_Status Provider_Handle::enum_instances(const Instance* model, Enum_Instances_Proc proc, void* client_data)
{
    return static_cast<Enum_Instances_Status>(
        call(_proc, _registration, OPERATION_ENUM_INSTANCES, _provider, model, proc, client_data));
}

Create_Instance_Status Provider_Handle::create_instance(Instance* instance)
{
    return static_cast<Create_Instance_Status>(call(_proc, _registration, OPERATION_CREATE_INSTANCE, _provider, instance));
}

Delete_Instance_Status Provider_Handle::delete_instance(const Instance* instance)
{
    return static_cast<Delete_Instance_Status>(call(_proc, _registration, OPERATION_DELETE_INSTANCE, _provider, instance));
}

Modify_Instance_Status Provider_Handle::modify_instance(const Instance* model, const Instance* instance)
{
    return static_cast<Modify_Instance_Status>(call(_proc, _registration, OPERATION_MODIFY_INSTANCE, _provider, model, instance));
}

Invoke_Method_Status Provider_Handle::invoke_method(const Instance* instance, Instance* method)
{
    return static_cast<Invoke_Method_Status>(call(_proc, _registration, OPERATION_INVOKE_METHOD, _provider, instance, method));
}

Enable_Indications_Status Provider_Handle::enable_indications(Indication_Proc proc, void* client_data)
{
    return static_cast<Enable_Indications_Status>(
        call(_proc, _registration, OPERATION_ENABLE_INDICATIONS, _provider, proc, client_data));
}

Disable_Indications_Status Provider_Handle::disable_indications()
{
    return static_cast<Disable_Indications_Status>(call(_proc, _registration, OPERATION_DISABLE_INDICATIONS, _provider));
}

Enum_Associators_Status Provider_Handle::enum_associators(const Instance* instance, const String& result_class,
                                                          const String& role, const String& result_role,
                                                          Enum_Associators_Proc proc, void* client_data)
{
    return static_cast<Enum_Associators_Status>(call(_proc, _registration, OPERATION_ENUM_ASSOCIATORS, _provider, instance,
                                                     &result_class, &role, &result_role, proc, client_data));
}

Enum_Associator_Names_Status Provider_Handle::enum_associator_names(const Instance* instance, const String& result_class,
                                                                    const String& role, const String& result_role,
                                                                    Enum_Associator_Names_Proc proc, void* client_data)
{
    const Meta_Class* meta_class = association_class();
    if (!meta_class)
        return ENUM_ASSOCIATOR_NAMES_FAILED;

    const auto answer =
        static_cast<Enum_Associator_Names_Status>(call(_proc, _registration, OPERATION_ENUM_ASSOCIATOR_NAMES, _provider, instance,
                                                       &result_class, &role, &result_role, proc, client_data));
    if (answer == ENUM_ASSOCIATOR_NAMES_OK || answer == ENUM_ASSOCIATOR_NAMES_FAILED ||
        answer == ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED)
        return answer;

    const Ref<Instance> model(create(meta_class, false));
    nullify_non_keys(model.ptr());
    Associator_Names_Args args{.instance = instance,
                               .result_class = result_class,
                               .role = role,
                               .result_role = result_role,
                               .proc = proc,
                               .client_data = client_data,
                               .far_ends = {}};
    const auto status = enum_instances(model.ptr(), pass_on_far_ends, &args);
    proc(nullptr, ENUM_ASSOCIATOR_NAMES_OK, client_data);

    return made_of<ENUM_ASSOCIATOR_NAMES_OK, ENUM_ASSOCIATOR_NAMES_FAILED, ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED>(status);
}

Enum_References_Status Provider_Handle::enum_references(const Instance* instance, const Instance* model, const String& role,
                                                        Enum_References_Proc proc, void* client_data)
{
    if (!association_class())
        return ENUM_REFERENCES_FAILED;

    const auto answer = static_cast<Enum_References_Status>(
        call(_proc, _registration, OPERATION_ENUM_REFERENCES, _provider, instance, model, &role, proc, client_data));
    if (answer == ENUM_REFERENCES_OK || answer == ENUM_REFERENCES_FAILED || answer == ENUM_REFERENCES_ACCESS_DENIED)
        return answer;

    References_Args args{instance, role, proc, client_data};
    const auto status = enum_instances(model, pass_on_reference, &args);
    proc(nullptr, ENUM_REFERENCES_OK, client_data);

    return made_of<ENUM_REFERENCES_OK, ENUM_REFERENCES_FAILED, ENUM_REFERENCES_ACCESS_DENIED>(status);
}

const Meta_Class* Provider_Handle::association_class() const
{
    const Meta_Class* meta_class = nullptr;
    get_meta_class(meta_class);
    return meta_class && (meta_class->flags & Flag_Association) ? meta_class : nullptr;
}

} // namespace zmlr
