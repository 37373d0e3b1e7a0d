// Changes of instances, methods and queries: each goes to the provider that has the instance.
#include "cimserver/module_operations.h"

#include "cimserver/key_conversion.h"
#include "cimserver/object_conversion.h"
#include "cimserver/provider_call.h"

#include <algorithm>
#include <cctype>
#include <sstream>

namespace cimserver
{
namespace
{

std::string not_served(const Class_Entry& entry) { return std::string("no provider serves class ") + entry.meta_class->name; }

CMPIInstance* new_instance(const Class_Entry& entry, const Instance& instance)
{
    auto& object = make<Instance_Object>(entry.layout, instance.path);
    for (const Named_Value& property : instance.properties)
        object.set(property.name, property.value);
    return object.face();
}

const zmlr::Meta_Method* find_method(const zmlr::Meta_Class& meta_class, const std::string& name)
{
    for (unsigned i = 0; i < meta_class.num_meta_features; ++i)
        if (zmlr::is_method(meta_class.meta_features[i]) && equal_names(meta_class.meta_features[i]->name, name))
            return zmlr::as_method(meta_class.meta_features[i]);
    return nullptr;
}

std::vector<std::string> names_of(const std::vector<Named_Value>& properties)
{
    std::vector<std::string> names;
    std::ranges::transform(properties, std::back_inserter(names), &Named_Value::name);
    return names;
}

} // namespace

std::string class_of_query(const std::string& query)
{
    std::istringstream words(query);
    std::string word;
    while (words >> word)
        if (equal_names(word, "from") && words >> word)
            return word.substr(0, word.find_first_of(",;"));
    throw Cim_Error(CIM_ERR_INVALID_QUERY, "the query names no class");
}

Module_Operations::Target Module_Operations::target_of(const Object_Path& path)
{
    const Class_Entry& named = known_class(path.class_name);
    if (named.registration)
        return {named, path_to(named, typed_keys(_module.repository(), named, path))};
    Object_Path found = get_instance(path, std::vector<std::string>()).path;
    const Class_Entry& provider = known_class(found.class_name);
    return {provider, std::move(found)};
}

Object_Path Module_Operations::create_instance(const Instance& instance)
{
    const Module::Use use(_module);
    const Class_Entry& entry = known_class(instance.path.class_name);
    Instance typed = typed_instance(_module.repository(), entry, instance, CIM_ERR_INVALID_PARAMETER);
    typed.path.name_space = _name_space;
    CMPIInstanceMI* mi = entry.registration ? _module.instance_mi(entry) : nullptr;
    if (!mi)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, not_served(entry));

    Path_Sink sink(_name_space);
    Provider_Call call(entry, typed.path, sink);
    call.run(mi, mi->ft->createInstance, new_instance(entry, typed));
    Object_Path made = sink.found.empty() ? typed.path : std::move(sink.found.front());
    if (made.keys.size() < entry.meta_class->num_keys)
        throw Cim_Error(CIM_ERR_FAILED, std::string(entry.registration->provider_name) + " made an instance without a full path");
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
    CMPIInstanceMI* mi = _module.instance_mi(target.provider);
    if (!mi)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, not_served(target.provider));

    Path_Sink sink(_name_space);
    Name_List names(changed);
    Provider_Call call(target.provider, target.path, sink);
    call.run(mi, mi->ft->modifyInstance, new_instance(target.provider, typed), names.names());
}

void Module_Operations::delete_instance(const Object_Path& path)
{
    const Module::Use use(_module);
    const Target target = target_of(path);
    CMPIInstanceMI* mi = _module.instance_mi(target.provider);
    if (!mi)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, not_served(target.provider));

    Path_Sink sink(_name_space);
    Provider_Call(target.provider, target.path, sink).run(mi, mi->ft->deleteInstance);
}

std::vector<Instance> Module_Operations::exec_query(const std::string&, const std::string& query, const std::string& language)
{
    const Module::Use use(_module);
    const std::string class_name = class_of_query(query);
    const Class_Entry* named = _classes.find(class_name);
    if (!named)
        throw Cim_Error(CIM_ERR_INVALID_QUERY, "there is no class " + class_name);

    const Property_List all;
    Instance_Sink sink(_name_space, all, nullptr);
    bool asked = false;
    for (const Class_Entry* provider : _classes.served(*named))
        if (CMPIInstanceMI* mi = _module.instance_mi(*provider))
        {
            Provider_Call(*provider, path_to(*provider), sink).run(mi, mi->ft->execQuery, query.c_str(), language.c_str());
            asked = true;
        }
    if (!asked)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, not_served(*named));
    return std::move(sink.found);
}

// Null when it cannot be told which provider is meant.
const Class_Entry* Module_Operations::method_provider(const Class_Entry& named, const Object_Path& path)
{
    if (named.registration)
        return &named;
    const auto providers = _classes.served(named);
    if (providers.empty() || (path.keys.empty() && providers.size() > 1))
        return nullptr;
    return path.keys.empty() ? providers.front() : &target_of(path).provider;
}

Method_Result Module_Operations::invoke_method(const Object_Path& path, const std::string& name,
                                               const std::vector<Named_Value>& in)
{
    const Module::Use use(_module);
    const Class_Entry& named = known_class(path.class_name);
    const Class_Entry* provider = method_provider(named, path);
    const zmlr::Meta_Method* method = find_method(provider ? *provider->meta_class : *named.meta_class, name);
    if (!method)
        throw Cim_Error(CIM_ERR_METHOD_NOT_FOUND, "class " + std::string(named.meta_class->name) + " has no method " + name);
    CMPIMethodMI* mi = provider ? _module.method_mi(*provider) : nullptr;
    if (!mi)
        throw Cim_Error(CIM_ERR_METHOD_NOT_AVAILABLE, "method " + name + ": " + not_served(named));

    const auto keys = path.keys.empty() ? path.keys : typed_keys(_module.repository(), *provider, path);
    Data_Sink sink;
    Provider_Call call(*provider, path_to(*provider, keys), sink);
    auto& in_arguments = make<Args_Object>();
    in_arguments.args = typed_arguments(_module.repository(), *method, in, _name_space);
    auto& out_arguments = make<Args_Object>();
    call.run(mi, mi->ft->invokeMethod, static_cast<const char*>(method->name), in_arguments.face(), out_arguments.face());
    return {std::move(sink.value), std::move(out_arguments.args)};
}

} // namespace cimserver
