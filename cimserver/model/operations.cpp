#include "cimserver/model/operations.h"

#include "cimserver/model/meta_search.h"

namespace cimserver
{

Value Operations::get_property(const Object_Path& path, const std::string& property)
{
    const Instance instance = get_instance(path, std::vector{property});
    const zmlr::Meta_Class& meta_class = *get_class(instance.path.class_name);
    if (!find_value(meta_class, property))
        throw Cim_Error(CIM_ERR_NO_SUCH_PROPERTY, "class " + std::string(meta_class.name) + " has no property " + property);
    const Value* found = instance.properties.find(property);
    return found ? *found : Value();
}

void Operations::set_property(const Object_Path& path, const std::string& property, const Value& value)
{
    try
    {
        modify_instance({path, {{property, value}}}, std::vector{property});
    }
    catch (const Type_Error& error)
    {
        throw Cim_Error(CIM_ERR_TYPE_MISMATCH, error.description());
    }
}

} // namespace cimserver
