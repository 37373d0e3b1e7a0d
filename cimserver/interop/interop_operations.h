// Interop_Operations: the interop name space "root/PG_InterOp", where clients discover the server and manage subscriptions.
//
// Its classes are the server's own (own_operations.h) and those of the module that clients look for there: the registered
// profiles and what ties them to elements. A class of the server's that has instances is never answered by the module: an
// enumeration of CIM_ObjectManager here does not come back to a subclass of the module's. This object answers for the other
// classes; the two trees meet in those that both have, such as CIM_ManagedElement.
#pragma once

#include "cimserver/interop/own_operations.h"
#include "cimserver/operations/module_operations.h"

namespace cimserver
{

class Interop_Operations : public Module_Operations
{
public:
    static constexpr const char* name_space = Own_Operations::name_space;

    explicit Interop_Operations(Module& module); // which must outlive it

    Own_Operations& own() { return _own; }
    Operations& at(const std::string& class_name); // the server's own part for a class of its, else this

    const zmlr::Meta_Class* get_class(const std::string& class_name) override;
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& class_name, bool deep_inheritance) override;
    std::vector<Object_Path> enumerate_instance_names(const std::string& class_name) override;
    std::vector<Instance> enumerate_instances(const std::string& class_name, bool deep_inheritance,
                                              const Property_List& properties) override;

private:
    bool only_own(const std::string& class_name) const; // the server's part has the class, the module's has not

    Own_Operations _own;
};

} // namespace cimserver
