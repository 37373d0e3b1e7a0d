// Changes of instances, and methods: each goes to the provider that has the instance.
#include "cimserver/operations/module_operations.h"

#include "cimserver/model/meta_search.h"
#include "cimserver/operations/provider_call.h"
#include "cimserver/operations/typed_keys.h"
#include "cimserver/operations/typed_objects.h"

#include <algorithm>

namespace cimserver
{
namespace
{

std::string not_served(const Class_Entry& entry) { return std::string("no provider serves class ") + entry.meta_class->name; }

CMPIInstanceMI* needed_instance_mi(Module& module, const Class_Entry& entry)
{
    if (CMPIInstanceMI* mi = entry.registration ? module.instance_mi(entry) : nullptr)
        return mi;
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, not_served(entry));
}

CMPIInstance* new_instance(const Class_Entry& entry, const Instance& instance)
{
    auto& object = make<Instance_Object>(entry.layout, instance.path);
    for (const auto& property : instance.properties)
        object.set(property.name, property.value);
    return object.face();
}

std::vector<std::string> names_of(const std::vector<Named_Value>& properties)
{
    std::vector<std::string> names;
    std::ranges::transform(properties, std::back_inserter(names), &Named_Value::name);
    return names;
}

} // namespace

Module_Operations::Target Module_Operations::target_of(const Object_Path& path)
{
    const Class_Entry& named = _classes.get(path.class_name);
    if (named.registration)
        return {named, path_to(named, typed_keys(_module.repository(), named, path))};
    Object_Path found = get_instance(path, std::vector<std::string>()).path;
    const Class_Entry& provider = _classes.get(found.class_name);
    return {provider, std::move(found)};
}

Object_Path Module_Operations::create_instance(const Instance& instance)
{
    const Module::Use use(_module);
    const Class_Entry& entry = _classes.get(instance.path.class_name);
    Instance typed = typed_instance(_module.repository(), entry, instance, CIM_ERR_INVALID_PARAMETER);
    typed.path.name_space = _name_space;
    CMPIInstanceMI* mi = needed_instance_mi(_module, entry);

    Path_Sink sink(_name_space);
    Provider_Call call(_module, entry, "CreateInstance", typed.path, sink);
    call.run(mi, mi->ft->createInstance, new_instance(entry, typed));
    Object_Path made = sink.found.empty() ? typed.path : std::move(sink.found.front());
    if (made.keys.size() < entry.meta_class->num_keys)
        throw Cim_Error(CIM_ERR_FAILED, std::string(entry.meta_class->name) + " made an instance without a full path");
    return made;
}

// Without a list, what the client sent is what it wants changed: a provider would take no list for all properties.
void Module_Operations::modify_instance(const Instance& instance, const Property_List& properties)
{
    const Module::Use use(_module);
    const Target target = target_of(instance.path);
    const Instance typed =
        typed_instance(_module.repository(), target.provider, {target.path, instance.properties}, CIM_ERR_NO_SUCH_PROPERTY);
    const Property_List changed = properties ? properties : names_of(instance.properties);
    for (const std::string& name : *changed)
        if (!target.provider.layout->find(name))
            throw Cim_Error(CIM_ERR_NO_SUCH_PROPERTY,
                            "class " + std::string(target.provider.meta_class->name) + " has no property " + name);
    CMPIInstanceMI* mi = needed_instance_mi(_module, target.provider);

    Path_Sink sink(_name_space);
    Name_List names(changed);
    Provider_Call call(_module, target.provider, "ModifyInstance", target.path, sink);
    call.run(mi, mi->ft->modifyInstance, new_instance(target.provider, typed), names.names());
}

void Module_Operations::delete_instance(const Object_Path& path)
{
    const Module::Use use(_module);
    const Target target = target_of(path);
    CMPIInstanceMI* mi = needed_instance_mi(_module, target.provider);

    Path_Sink sink(_name_space);
    Provider_Call(_module, target.provider, "DeleteInstance", target.path, sink).run(mi, mi->ft->deleteInstance);
}

// Null when it cannot be told which provider is meant.
const Class_Entry* Module_Operations::method_provider(const Class_Entry& named, const Object_Path& path)
{
    if (named.registration)
        return &named;
    const auto& providers = _classes.served(named);
    if (providers.empty() || (path.keys.empty() && providers.size() > 1))
        return nullptr;
    return path.keys.empty() ? providers.front() : &target_of(path).provider;
}

Method_Result Module_Operations::invoke_method(const Object_Path& path, const std::string& name,
                                               const std::vector<Named_Value>& in)
{
    const Module::Use use(_module);
    const Class_Entry& named = _classes.get(path.class_name);
    const Class_Entry* provider = method_provider(named, path);
    const zmlr::Meta_Feature* feature = find_feature(provider ? *provider->meta_class : *named.meta_class, name);
    if (!feature || !zmlr::is_method(feature))
        throw Cim_Error(CIM_ERR_METHOD_NOT_FOUND, "class " + std::string(named.meta_class->name) + " has no method " + name);
    const zmlr::Meta_Method* method = zmlr::as_method(feature);
    CMPIMethodMI* mi = provider ? _module.method_mi(*provider) : nullptr;
    if (!mi)
        throw Cim_Error(CIM_ERR_METHOD_NOT_AVAILABLE, "method " + name + ": " + not_served(named));

    const auto keys = path.keys.empty() ? path.keys : typed_keys(_module.repository(), *provider, path);
    Data_Sink sink;
    Provider_Call call(_module, *provider, method->name, path_to(*provider, keys), sink);
    auto& in_arguments = make<Args_Object>();
    in_arguments.args = typed_arguments(_module.repository(), *method, in, _name_space);
    auto& out_arguments = make<Args_Object>();
    call.run(mi, mi->ft->invokeMethod, static_cast<const char*>(method->name), in_arguments.face(), out_arguments.face());
    return {std::move(sink.value), std::move(out_arguments.args)};
}

} // namespace cimserver
