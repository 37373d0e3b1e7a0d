// The CIM operations (DSP0200) that clients may ask for. Every one throws Cim_Error when it fails.
//
// Safe to call from several threads at once. The HTTP side calls these interfaces; Module_Operations answers them from the
// loaded module, and tests put their own answers behind them.
#pragma once

#include "cimserver/model/values.h"
#include "runtime/meta.h"

#include <string>
#include <utility>
#include <vector>

namespace cimserver
{

// A value in a request that is none of its type: CIM_ERR_INVALID_PARAMETER.
class Type_Error : public Cim_Error
{
public:
    explicit Type_Error(std::string description) : Cim_Error(CIM_ERR_INVALID_PARAMETER, std::move(description)) {}
};

// What a client asks of an association traversal; an empty text asks nothing.
struct Association_Filter
{
    std::string association_class; // or a superclass of it
    std::string result_class;      // of the object at the other end, or a superclass of it
    std::string role;              // the reference that names the source
    std::string result_role;       // the reference that names the object at the other end
};

struct Method_Result
{
    Value return_value;
    std::vector<Named_Value> out; // the output parameters that the provider gave
};

// The operations in one name space, whatever name space a path says.
class Operations
{
public:
    Operations() = default;
    virtual ~Operations() = default;
    Operations(const Operations&) = delete;
    Operations& operator=(const Operations&) = delete;

    // Whether reading instances may take as long as a provider likes.
    virtual bool asks_providers() const { return true; }

    // Class operations, answered from the meta-data. An empty class name means: from the top of the tree.
    // An unknown class is CIM_ERR_NOT_FOUND to get_class and CIM_ERR_INVALID_CLASS to every other operation (DSP0200).
    virtual const zmlr::Meta_Class* get_class(const std::string& class_name) = 0;
    virtual std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& class_name, bool deep_inheritance) = 0;

    // Instance operations. A superclass is the union of its served subclasses, each instance with the path of its own
    // class. Without deep inheritance the instances hold only the properties of the class that was named.
    virtual std::vector<Object_Path> enumerate_instance_names(const std::string& class_name) = 0;
    virtual std::vector<Instance> enumerate_instances(const std::string& class_name, bool deep_inheritance,
                                                      const Property_List& properties) = 0;

    // The keys are checked against the class: a missing, unknown or ill-typed one is CIM_ERR_INVALID_PARAMETER. Key values
    // may come untyped (string, boolean, or a number as text): they are converted to the class's key types.
    virtual Instance get_instance(const Object_Path& path, const Property_List& properties) = 0;

    // Changes of instances, by the provider of the class. The values of an instance may come untyped, as the keys may; an
    // array may hold texts. They are converted to the types of the class. A value that does not fit is CIM_ERR_INVALID_PARAMETER;
    // a property that the class has not is that too in create_instance, and CIM_ERR_NO_SUCH_PROPERTY in modify_instance.
    virtual Object_Path create_instance(const Instance& instance) = 0; // the path needs no keys
    // No list: those that the instance holds.
    virtual void modify_instance(const Instance& instance, const Property_List& properties) = 0;
    virtual void delete_instance(const Object_Path& path) = 0;

    // Answered through the two operations on whole instances, with their errors. CIM_ERR_NO_SUCH_PROPERTY when the class has
    // no such property; CIM_ERR_TYPE_MISMATCH when the new value is none of its type.
    Value get_property(const Object_Path& path, const std::string& property);
    void set_property(const Object_Path& path, const std::string& property, const Value& value);

    // Association traversal, from an instance: the union over every association class that can concern it and that the filter
    // admits, each object once, with the path of its own name space. A class that the filter names must exist:
    // CIM_ERR_INVALID_PARAMETER. An instance that does not exist has no associations.
    virtual std::vector<Instance> associators(const Object_Path& path, const Association_Filter& filter,
                                              const Property_List& properties) = 0;
    virtual std::vector<Object_Path> associator_names(const Object_Path& path, const Association_Filter& filter) = 0;

    // The same for the associations themselves: only the filter's association class and role count.
    virtual std::vector<Instance> references(const Object_Path& path, const Association_Filter& filter,
                                             const Property_List& properties) = 0;
    virtual std::vector<Object_Path> reference_names(const Object_Path& path, const Association_Filter& filter) = 0;

    // An extrinsic method of an instance, or with a path without keys of a class. Values as in create_instance; a parameter
    // that the method has not, or takes nothing in, is CIM_ERR_INVALID_PARAMETER.
    virtual Method_Result invoke_method(const Object_Path& path, const std::string& method,
                                        const std::vector<Named_Value>& in) = 0;
};

// Who answers what: the one place through which every request goes.
class Name_Spaces
{
public:
    Name_Spaces() = default;
    virtual ~Name_Spaces() = default;
    Name_Spaces(const Name_Spaces&) = delete;
    Name_Spaces& operator=(const Name_Spaces&) = delete;

    // The operations on a class (empty: on the whole tree of classes) of a name space. Whether there is such a class is for
    // the operation to tell. Throws CIM_ERR_INVALID_NAMESPACE.
    virtual Operations& at(const std::string& name_space, const std::string& class_name) = 0;
    Operations& at(const Object_Path& path) { return at(path.name_space, path.class_name); }
};

} // namespace cimserver
