// The instances and arguments of a request, checked against their class and converted to its types.
#pragma once

#include "cimserver/model/repository.h"

#include <string>
#include <vector>

namespace cimserver
{

// The instance with the names and types of its class. The keys of its path are checked and stand among its properties too;
// a path without keys gets those that the properties give. Values are converted as operations.h tells; any other property
// that is not given stays away.
//
// Throws Type_Error for a value that is none of its type and a property given twice, Key_Error for wrong keys in the path, and a
// Cim_Error with the code `unknown_property` for a property that the class has not and INVALID_PARAMETER for a key that
// contradicts the path.
Instance typed_instance(const Repository& repository, const Class_Entry& entry, const Instance& instance, int unknown_property);

// The input arguments with the names and types of the method's parameters, in their order. References without a name space
// take the one given. Throws Type_Error for a value that is none of its type, an argument given twice and one that the method
// does not take.
std::vector<Named_Value> typed_arguments(const Repository& repository, const zmlr::Meta_Method& method,
                                         const std::vector<Named_Value>& in, const std::string& name_space);

} // namespace cimserver
