#include "cimserver/operations/module_operations.h"

#include "cimserver/broker/cmpi_values.h"
#include "cimserver/model/paths.h"
#include "cimserver/operations/provider_call.h"
#include "cimserver/operations/typed_keys.h"

namespace cimserver
{
Module_Operations::Module_Operations(Module& module)
    : _module(module)
    , _name_space(served_name_space)
    , _classes(module.repository())
{
}

Module_Operations::Module_Operations(Module& module, std::string name_space, std::span<const std::string_view> roots)
    : _module(module)
    , _name_space(std::move(name_space))
    , _part(std::in_place, module.repository(), roots)
    , _classes(*_part)
{
}

Object_Path Module_Operations::path_to(const Class_Entry& entry, std::vector<Named_Value> keys) const
{
    return {{}, _name_space, entry.name, std::move(keys)};
}

// Of all operations, only this one calls an unknown class "not found" (DSP0200).
const zmlr::Meta_Class* Module_Operations::get_class(const std::string& class_name)
{
    return _classes.get(class_name, CIM_ERR_NOT_FOUND).meta_class;
}

std::vector<const zmlr::Meta_Class*> Module_Operations::enumerate_classes(const std::string& class_name, bool deep_inheritance)
{
    const zmlr::Meta_Class* parent = class_name.empty() ? nullptr : _classes.get(class_name).meta_class;
    return _classes.subclasses(parent, deep_inheritance);
}

std::vector<Object_Path> Module_Operations::enumerate_instance_names(const std::string& class_name)
{
    const Module::Use use(_module);
    const auto& providers = _classes.served(_classes.get(class_name));

    Path_Sink sink(_name_space);
    for (const Class_Entry* provider : providers)
        if (CMPIInstanceMI* mi = _module.instance_mi(*provider))
            Provider_Call(_module, *provider, "EnumerateInstanceNames", path_to(*provider), sink)
                .run(mi, mi->ft->enumerateInstanceNames);
    if (providers.size() > 1)
        remove_duplicates(sink.found);
    return std::move(sink.found);
}

std::vector<Instance> Module_Operations::enumerate_instances(const std::string& class_name, bool deep_inheritance,
                                                             const Property_List& properties)
{
    const Module::Use use(_module);
    const Class_Entry& named = _classes.get(class_name);
    const auto& providers = _classes.served(named);

    Instance_Sink sink(_name_space, deep_inheritance ? properties : named.layout->names(properties));
    for (const Class_Entry* provider : providers)
        if (CMPIInstanceMI* mi = _module.instance_mi(*provider))
        {
            Name_List names(properties, provider->layout.get());
            Provider_Call call(_module, *provider, "EnumerateInstances", path_to(*provider), sink,
                               deep_inheritance ? CMPI_FLAG_DeepInheritance : 0);
            call.run(mi, mi->ft->enumerateInstances, names.names());
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
    const Class_Entry& named = _classes.get(path.class_name);
    const auto& providers = _classes.served(named);
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

    Instance_Sink sink(_name_space, properties);
    Name_List names(properties, provider.layout.get());
    Provider_Call(_module, provider, "GetInstance", path_to(provider, std::move(keys)), sink)
        .run(mi, mi->ft->getInstance, names.names());
    if (sink.found.empty())
        return std::nullopt;
    return std::move(sink.found.front());
}

} // namespace cimserver
