// The keys of a request path, checked against the class and converted to its key types.
#pragma once

#include "cimserver/model/repository.h"

#include <vector>

namespace cimserver
{

// CIM_ERR_INVALID_PARAMETER with a description that names the class and the key.
class Key_Error : public Cim_Error
{
public:
    explicit Key_Error(std::string description) : Cim_Error(CIM_ERR_INVALID_PARAMETER, std::move(description)) {}
};

// The keys in class order. A value may come typed, or as a client's text (value_reader.h). A reference is converted with
// the class that it names, and takes the name space of the path it stands in when it has none.
//
// Throws Key_Error for a key that is missing, unknown, given twice, or no value of its type.
std::vector<Named_Value> typed_keys(const Repository& repository, const Class_Entry& entry, const Object_Path& path);

// The path in a value for a reference, with typed keys; null when it names no class that may stand there. A path without a
// name space takes the one given. Throws Key_Error for wrong keys.
Value::Content typed_reference(const Repository& repository, const zmlr::Meta_Reference& reference, const Value& value,
                               const std::string& name_space);

} // namespace cimserver
