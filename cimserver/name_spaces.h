// Name_Spaces: all operations of the server, each answered by the name space that its request names.
//
// "root/zemlar" holds the module's classes, "root/PG_InterOp" the server's. Names are compared without regard to case, and a
// slash in front or at the end does not count; another name is CIM_ERR_INVALID_NAMESPACE.
#pragma once

#include "cimserver/interop/interop_operations.h"
#include "cimserver/module_operations.h"
#include "cimserver/operations.h"

#include <string>
#include <vector>

namespace cimserver
{

class Name_Spaces : public Operations
{
public:
    // From now on this object answers the module's up-calls. The destructor closes the module, which must outlive this object.
    explicit Name_Spaces(Module& module);
    ~Name_Spaces() override;

    Interop_Operations& interop() { return _interop; }

    const zmlr::Meta_Class* get_class(const std::string& name_space, const std::string& class_name) override;
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& name_space, const std::string& class_name,
                                                           bool deep_inheritance) override;
    std::vector<Object_Path> enumerate_instance_names(const std::string& name_space, const std::string& class_name) override;
    std::vector<Instance> enumerate_instances(const std::string& name_space, const std::string& class_name, bool deep_inheritance,
                                              const Property_List& properties) override;
    Instance get_instance(const Object_Path& path, const Property_List& properties) override;
    Object_Path create_instance(const Instance& instance) override;
    void modify_instance(const Instance& instance, const Property_List& properties) override;
    void delete_instance(const Object_Path& path) override;
    std::vector<Instance> exec_query(const std::string& name_space, const std::string& query,
                                     const std::string& language) override;
    std::vector<Instance> associators(const Object_Path& path, const Association_Filter& filter,
                                      const Property_List& properties) override;
    std::vector<Object_Path> associator_names(const Object_Path& path, const Association_Filter& filter) override;
    std::vector<Instance> references(const Object_Path& path, const Association_Filter& filter,
                                     const Property_List& properties) override;
    std::vector<Object_Path> reference_names(const Object_Path& path, const Association_Filter& filter) override;
    Method_Result invoke_method(const Object_Path& path, const std::string& method, const std::vector<Named_Value>& in) override;

private:
    Operations& at(const std::string& name_space);

    Module& _module;
    Module_Operations _served;
    Interop_Operations _interop;
};

} // namespace cimserver
