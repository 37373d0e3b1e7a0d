// The CIM operations (DSP0200) that clients may ask for. Every one throws Cim_Error when it fails.
//
// Safe to call from several threads at once. The HTTP side calls this interface; Module_Operations answers it from the
// loaded module, and tests put their own answers behind it.
#pragma once

#include "cimserver/broker/model.h"
#include "runtime/meta.h"

#include <string>
#include <vector>

namespace cimserver
{

class Operations
{
public:
    Operations() = default;
    virtual ~Operations() = default;
    Operations(const Operations&) = delete;
    Operations& operator=(const Operations&) = delete;

    // Class operations, answered from the module's meta-data. An empty class name means: from the top of the tree.
    // An unknown class is CIM_ERR_NOT_FOUND to get_class and CIM_ERR_INVALID_CLASS to every other operation (DSP0200).
    virtual const zmlr::Meta_Class* get_class(const std::string& name_space, const std::string& class_name) = 0;
    virtual std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& name_space, const std::string& class_name,
                                                                   bool deep_inheritance) = 0;

    // Instance operations. A superclass is the union of its served subclasses, each instance with the path of its own
    // class. Without deep inheritance the instances hold only the properties of the class that was named.
    virtual std::vector<Object_Path> enumerate_instance_names(const std::string& name_space, const std::string& class_name) = 0;
    virtual std::vector<Instance> enumerate_instances(const std::string& name_space, const std::string& class_name,
                                                      bool deep_inheritance, const Property_List& properties) = 0;

    // The keys are checked against the class: a missing, unknown or ill-typed one is CIM_ERR_INVALID_PARAMETER. Key values
    // may come untyped (string, boolean, or a number as text): they are converted to the class's key types.
    virtual Instance get_instance(const Object_Path& path, const Property_List& properties) = 0;

    // An extrinsic method of a class or an instance: whether it can be called at all.
    virtual void invoke_method(const Object_Path& path, const std::string& method) = 0;
};

} // namespace cimserver
