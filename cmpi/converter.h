// Conversion between CMPI objects and instances, and between CMPI data and values.
//
// The make functions answer CMPI_RC_OK, or CMPI_RC_ERR_FAILED with nothing made; the value functions answer 0 or -1. What
// goes wrong is logged at LL_WARN. `name_space` serves where an instance has no name space of its own.
#pragma once

#include "cmpi/cmpi_data.h"
#include "cmpi/cmpi_objects.h"
#include "runtime/instance.h"
#include "runtime/value.h"

#include <cmpidt.h>

#include <vector>

namespace zmlr
{

// A property list as a server takes it: the names that a caller asks for (null: everything), and beside them the keys of the
// class, which are asked for once per class and not per object.
class Property_Filter
{
public:
    Property_Filter(const char** names = nullptr) : _names(names) {} // borrowed
    explicit operator bool() const { return _names != nullptr; }
    const char** names() const { return _names; }

    // Installs it on an instance of the class: the server's answer.
    CMPIrc install(CMPIInstance* instance, const Meta_Class* meta_class) const;

private:
    const char** _names;
    mutable const Meta_Class* _class = nullptr; // of the keys
    mutable std::vector<const char*> _keys;
};

// The path with the instance's keys.
CMPIrc make_cmpi_object_path(const CMPIBroker* broker, const Instance* instance, const char* name_space,
                             CMPI_Ptr<CMPIObjectPath>& path);

// The whole instance under a path (null: the one of its keys, which is logged). What nobody else holds ends value by value while
// it is converted; `name_space` may be the instance's own. A property list is installed as the instance's property filter; the
// code of a failing filter call is answered as it is.
CMPIrc make_cmpi_instance(const CMPIBroker* broker, Ref<Instance> instance, const char* name_space, const CMPIObjectPath* path,
                          const Property_Filter& filter, CMPI_Ptr<CMPIInstance>& cmpi_instance);

// The same under the path of its keys, which are converted once.
CMPIrc make_cmpi_object(const CMPIBroker* broker, Ref<Instance> instance, const char* name_space, const Property_Filter& filter,
                        CMPI_Ptr<CMPIInstance>& cmpi_instance);

// An instance of meta_class with the properties of a CMPI instance. It and what it references get the path's name space
// where they have none.
CMPIrc make_cimple_instance(const CMPIBroker* broker, const Meta_Class* meta_class, const CMPIObjectPath* path,
                            const CMPIInstance* cmpi_instance, Ref<Instance>& instance);

// The same with the keys of a path; every other property is null.
CMPIrc make_cimple_reference(const CMPIBroker* broker, const Meta_Class* meta_class, const CMPIObjectPath* path,
                             Ref<Instance>& instance);

// The parameter record of a method of meta_class with the input arguments (null: none): parameters that no argument names,
// outputs and the return value are null. Name spaces as for make_cimple_instance.
CMPIrc make_cimple_method(const CMPIBroker* broker, const Meta_Class* meta_class, const Meta_Method* meta_method,
                          const CMPIObjectPath* path, const CMPIArgs* in, Ref<Instance>& method);

// The non-null outputs of a parameter record become arguments in `out` (null: nobody asks), its return value `return_value`,
// which stays empty when the method set none.
CMPIrc make_cmpi_method(const CMPIBroker* broker, const char* name_space, const Instance* method, CMPIArgs* out,
                        CMPI_Data& return_value);

// Data become a value of the matching type; a null value if their state says so. References become instances with the keys
// of the referenced object, embedded objects whole instances: their classes are looked up in the repository. What is nested more
// than 16 deep fails, which leaves the feature that holds it null.
int cmpi_to_cimple_value(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                         const CMPIData& data, Value& value);

// A value becomes data. `flags` are those of its feature: they tell an embedded object from a reference.
int _to_cmpi_data(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space, const Value& value,
                  uint32 flags, CMPI_Data& data);

} // namespace zmlr
