#include "cimserver/operations.h"

#include "cimserver/broker/names.h"

#include <algorithm>

namespace cimserver
{
namespace
{

[[noreturn]] void not_supported(const char* operation)
{
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("operation not supported: ") + operation);
}

void check_property(const zmlr::Meta_Class& meta_class, const std::string& property)
{
    const auto* end = meta_class.meta_features + meta_class.num_meta_features;
    const bool known = std::any_of(meta_class.meta_features, end,
                                   [&](const zmlr::Meta_Feature* feature)
                                   { return !zmlr::is_method(feature) && equal_names(feature->name, property); });
    if (!known)
        throw Cim_Error(CIM_ERR_NO_SUCH_PROPERTY, "class " + std::string(meta_class.name) + " has no property " + property);
}

} // namespace

Object_Path Operations::create_instance(const Instance&) { not_supported("CreateInstance"); }

void Operations::modify_instance(const Instance&, const Property_List&) { not_supported("ModifyInstance"); }

void Operations::delete_instance(const Object_Path&) { not_supported("DeleteInstance"); }

std::vector<Instance> Operations::exec_query(const std::string&, const std::string&, const std::string&)
{
    not_supported("ExecQuery");
}

std::vector<Instance> Operations::associators(const Object_Path&, const Association_Filter&, const Property_List&)
{
    not_supported("Associators");
}

std::vector<Object_Path> Operations::associator_names(const Object_Path&, const Association_Filter&)
{
    not_supported("AssociatorNames");
}

std::vector<Instance> Operations::references(const Object_Path&, const Association_Filter&, const Property_List&)
{
    not_supported("References");
}

std::vector<Object_Path> Operations::reference_names(const Object_Path&, const Association_Filter&)
{
    not_supported("ReferenceNames");
}

Method_Result Operations::invoke_method(const Object_Path&, const std::string&, const std::vector<Named_Value>&)
{
    not_supported("a method call");
}

Value Operations::get_property(const Object_Path& path, const std::string& property)
{
    const Instance instance = get_instance(path, std::vector{property});
    check_property(*get_class(instance.path.name_space, instance.path.class_name), property);
    const Named_Value* found = find_named(instance.properties, property);
    return found ? found->value : Value();
}

void Operations::set_property(const Object_Path& path, const std::string& property, const Value& value)
{
    Instance instance{path, {{property, value}}};
    try
    {
        modify_instance(instance, std::vector{property});
    }
    catch (const Type_Error& error)
    {
        throw Cim_Error(CIM_ERR_TYPE_MISMATCH, error.description());
    }
}

} // namespace cimserver
