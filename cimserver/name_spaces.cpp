#include "cimserver/name_spaces.h"

#include "cimserver/interop/object_manager.h"

namespace cimserver
{

Name_Spaces::Name_Spaces(Module& module) : _module(module), _served(module), _interop(module)
{
    _interop.serve(make_object_manager());
    _interop.serve(make_name_space_class({Interop_Operations::name_space, Module_Operations::served_name_space}));
    _module.broker().set_operations(this);
}

// Closed first: threads of the module may be in up-calls until then.
Name_Spaces::~Name_Spaces()
{
    _module.close();
    _module.broker().set_operations(nullptr);
}

Operations& Name_Spaces::at(const std::string& name_space)
{
    std::string_view name = name_space;
    while (name.starts_with('/'))
        name.remove_prefix(1);
    while (name.ends_with('/'))
        name.remove_suffix(1);
    if (equal_names(name, Module_Operations::served_name_space))
        return _served;
    if (equal_names(name, Interop_Operations::name_space))
        return _interop;
    throw Cim_Error(CIM_ERR_INVALID_NAMESPACE, "there is no name space " + name_space);
}

const zmlr::Meta_Class* Name_Spaces::get_class(const std::string& name_space, const std::string& class_name)
{
    return at(name_space).get_class(name_space, class_name);
}

std::vector<const zmlr::Meta_Class*> Name_Spaces::enumerate_classes(const std::string& name_space, const std::string& class_name,
                                                                    bool deep_inheritance)
{
    return at(name_space).enumerate_classes(name_space, class_name, deep_inheritance);
}

std::vector<Object_Path> Name_Spaces::enumerate_instance_names(const std::string& name_space, const std::string& class_name)
{
    return at(name_space).enumerate_instance_names(name_space, class_name);
}

std::vector<Instance> Name_Spaces::enumerate_instances(const std::string& name_space, const std::string& class_name,
                                                       bool deep_inheritance, const Property_List& properties)
{
    return at(name_space).enumerate_instances(name_space, class_name, deep_inheritance, properties);
}

Instance Name_Spaces::get_instance(const Object_Path& path, const Property_List& properties)
{
    return at(path.name_space).get_instance(path, properties);
}

Object_Path Name_Spaces::create_instance(const Instance& instance)
{
    return at(instance.path.name_space).create_instance(instance);
}

void Name_Spaces::modify_instance(const Instance& instance, const Property_List& properties)
{
    at(instance.path.name_space).modify_instance(instance, properties);
}

void Name_Spaces::delete_instance(const Object_Path& path) { at(path.name_space).delete_instance(path); }

std::vector<Instance> Name_Spaces::exec_query(const std::string& name_space, const std::string& query,
                                              const std::string& language)
{
    return at(name_space).exec_query(name_space, query, language);
}

std::vector<Instance> Name_Spaces::associators(const Object_Path& path, const Association_Filter& filter,
                                               const Property_List& properties)
{
    return at(path.name_space).associators(path, filter, properties);
}

std::vector<Object_Path> Name_Spaces::associator_names(const Object_Path& path, const Association_Filter& filter)
{
    return at(path.name_space).associator_names(path, filter);
}

std::vector<Instance> Name_Spaces::references(const Object_Path& path, const Association_Filter& filter,
                                              const Property_List& properties)
{
    return at(path.name_space).references(path, filter, properties);
}

std::vector<Object_Path> Name_Spaces::reference_names(const Object_Path& path, const Association_Filter& filter)
{
    return at(path.name_space).reference_names(path, filter);
}

Method_Result Name_Spaces::invoke_method(const Object_Path& path, const std::string& method, const std::vector<Named_Value>& in)
{
    return at(path.name_space).invoke_method(path, method, in);
}

} // namespace cimserver
