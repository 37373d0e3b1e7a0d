#include "cimserver/interop/name_spaces.h"

#include "cimserver/interop/object_manager.h"

namespace cimserver
{

Server_Name_Spaces::Server_Name_Spaces(Module& module) : _module(module), _served(module), _interop(module)
{
    own().serve(object_manager_class());
    own().serve(name_space_class(
        {Own_Operations::names[0], Own_Operations::names[1], Own_Operations::names[2], Module_Operations::served_name_space}));
    _module.broker().set_name_spaces(this);
}

// Closed first: threads of the module may be in up-calls until then.
Server_Name_Spaces::~Server_Name_Spaces()
{
    _module.close();
    _module.broker().set_name_spaces(nullptr);
}

Operations& Server_Name_Spaces::at(const std::string& name_space, const std::string& class_name)
{
    std::string_view name = name_space;
    while (name.starts_with('/'))
        name.remove_prefix(1);
    while (name.ends_with('/'))
        name.remove_suffix(1);

    if (equal_names(name, Module_Operations::served_name_space))
        return _served;
    if (Own_Operations::is_name(name))
        return _interop.at(class_name);
    throw Cim_Error(CIM_ERR_INVALID_NAMESPACE, "there is no name space " + name_space);
}

} // namespace cimserver
