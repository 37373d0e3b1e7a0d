#include "cimserver/module_operations.h"

#include "cimserver/broker/conversion.h"
#include "cimserver/key_conversion.h"
#include "cimserver/provider_call.h"

#include <algorithm>
#include <unordered_set>

namespace cimserver
{
namespace
{

void check_name_space(std::string_view name_space)
{
    const std::string given(name_space);
    while (name_space.starts_with('/'))
        name_space.remove_prefix(1);
    while (name_space.ends_with('/'))
        name_space.remove_suffix(1);
    if (!equal_names(name_space, Module_Operations::served_name_space))
        throw Cim_Error(CIM_ERR_INVALID_NAMESPACE, "there is no name space " + given);
}

// What two paths have in common exactly when they name the same instance.
std::string identity(Object_Path path)
{
    path.class_name = lower_name(path.class_name);
    path.name_space = lower_name(path.name_space);
    for (Named_Value& key : path.keys)
        key.name = lower_name(key.name);
    std::sort(path.keys.begin(), path.keys.end(), [](const auto& a, const auto& b) { return a.name < b.name; });
    return path_text(path);
}

const Object_Path& path_of(const Object_Path& path) { return path; }
const Object_Path& path_of(const Instance& instance) { return instance.path; }

// A provider of a class may answer its subclasses' instances too, which their own provider answers again.
template <class T> void remove_duplicates(std::vector<T>& found)
{
    std::unordered_set<std::string> seen;
    std::erase_if(found, [&](const T& element) { return !seen.insert(identity(path_of(element))).second; });
}

} // namespace

Module_Operations::Module_Operations(Module& module) : _module(module) { _module.broker().set_operations(this); }

// Closed first: threads of the module may be in up-calls until then.
Module_Operations::~Module_Operations()
{
    _module.close();
    _module.broker().set_operations(nullptr);
}

const Class_Entry& Module_Operations::known_class(const std::string& name_space, const std::string& class_name) const
{
    check_name_space(name_space);
    const Class_Entry* entry = _module.repository().find(class_name);
    if (!entry)
        throw Cim_Error(CIM_ERR_INVALID_CLASS, "there is no class " + class_name);
    return *entry;
}

const zmlr::Meta_Class* Module_Operations::get_class(const std::string& name_space, const std::string& class_name)
{
    check_name_space(name_space);
    const Class_Entry* entry = _module.repository().find(class_name);
    if (!entry) // DSP0200: of all operations, only this one calls an unknown class "not found"
        throw Cim_Error(CIM_ERR_NOT_FOUND, "there is no class " + class_name);
    return entry->meta_class;
}

std::vector<const zmlr::Meta_Class*> Module_Operations::enumerate_classes(const std::string& name_space,
                                                                          const std::string& class_name, bool deep_inheritance)
{
    check_name_space(name_space);
    const zmlr::Meta_Class* parent = class_name.empty() ? nullptr : known_class(name_space, class_name).meta_class;
    return _module.repository().subclasses(parent, deep_inheritance);
}

std::vector<Object_Path> Module_Operations::enumerate_instance_names(const std::string& name_space, const std::string& class_name)
{
    const Module::Use use(_module);
    const auto providers = _module.repository().served(known_class(name_space, class_name));

    Path_Sink sink(served_name_space);
    for (const Class_Entry* provider : providers)
        if (CMPIInstanceMI* mi = _module.instance_mi(*provider))
        {
            Provider_Call call(*provider, served_name_space, sink, 0);
            call.check(mi->ft->enumerateInstanceNames(mi, call.context(), call.result(), call.path()));
        }
    if (providers.size() > 1)
        remove_duplicates(sink.found);
    return std::move(sink.found);
}

std::vector<Instance> Module_Operations::enumerate_instances(const std::string& name_space, const std::string& class_name,
                                                             bool deep_inheritance, const Property_List& properties)
{
    const Module::Use use(_module);
    const Class_Entry& named = known_class(name_space, class_name);
    const auto providers = _module.repository().served(named);

    Instance_Sink sink(served_name_space, properties, deep_inheritance ? nullptr : named.layout.get());
    for (const Class_Entry* provider : providers)
        if (CMPIInstanceMI* mi = _module.instance_mi(*provider))
        {
            Name_List names(properties, *provider->layout);
            Provider_Call call(*provider, served_name_space, sink, deep_inheritance ? CMPI_FLAG_DeepInheritance : 0);
            call.check(mi->ft->enumerateInstances(mi, call.context(), call.result(), call.path(), names.names()));
        }
    if (providers.size() > 1)
        remove_duplicates(sink.found);
    return std::move(sink.found);
}

// A provider whose class's keys do not fit the path, and one that answers without a result, does not have the instance; an
// error of another kind is told only when no provider has it.
Instance Module_Operations::get_instance(const Object_Path& path, const Property_List& properties)
{
    const Module::Use use(_module);
    const Class_Entry& named = known_class(path.name_space, path.class_name);
    const auto providers = _module.repository().served(named);
    if (providers.empty())
        typed_keys(_module.repository(), named, path);

    std::optional<Cim_Error> outcome;
    std::size_t refused = 0;
    for (const Class_Entry* provider : providers)
    {
        try
        {
            if (auto found = find_instance(*provider, typed_keys(_module.repository(), *provider, path), properties))
                return *std::move(found);
        }
        catch (const Key_Error& error)
        {
            if (++refused == providers.size())
                outcome = error;
        }
        catch (const Cim_Error& error)
        {
            if (error.code() != CIM_ERR_NOT_FOUND)
                outcome = error;
        }
    }
    if (outcome)
        throw *outcome;
    throw Cim_Error(CIM_ERR_NOT_FOUND, "there is no instance " + path_text(path)); // the keys are known to be sound
}

std::optional<Instance> Module_Operations::find_instance(const Class_Entry& provider, std::vector<Named_Value> keys,
                                                         const Property_List& properties)
{
    CMPIInstanceMI* mi = _module.instance_mi(provider);
    if (!mi)
        return std::nullopt;

    Instance_Sink sink(served_name_space, properties, nullptr);
    Name_List names(properties, *provider.layout);
    Provider_Call call(provider, served_name_space, sink, 0, std::move(keys));
    call.check(mi->ft->getInstance(mi, call.context(), call.result(), call.path(), names.names()));
    if (sink.found.empty())
        return std::nullopt;
    return std::move(sink.found.front());
}

void Module_Operations::invoke_method(const Object_Path& path, const std::string& method)
{
    const zmlr::Meta_Class& meta_class = *known_class(path.name_space, path.class_name).meta_class;
    const auto* end = meta_class.meta_features + meta_class.num_meta_features;
    const bool known = std::any_of(meta_class.meta_features, end,
                                   [&](const zmlr::Meta_Feature* feature)
                                   { return zmlr::is_method(feature) && equal_names(feature->name, method); });
    if (!known)
        throw Cim_Error(CIM_ERR_METHOD_NOT_FOUND, "class " + std::string(meta_class.name) + " has no method " + method);
    throw Cim_Error(CIM_ERR_METHOD_NOT_AVAILABLE, "method " + method + " cannot be called through this server");
}

} // namespace cimserver
