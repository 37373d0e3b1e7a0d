// Server_Class: a class whose instances are the server's own, in the interop name space.
#pragma once

#include "cimserver/model/values.h"
#include "runtime/meta.h"

#include <functional>
#include <vector>

namespace cimserver
{

// The functions are called on several threads at once. Own_Operations checks a request before it comes here: paths have all the
// keys of the class, typed; instances hold only properties of the class, typed. Every function may throw Cim_Error.
//
// An answer may leave properties out that are null, and the name space of its path; it names the class itself.
struct Server_Class
{
    const zmlr::Meta_Class& meta_class; // one of server_schema.h
    std::function<std::vector<Instance>()> enumerate;
    std::function<Object_Path(const Instance&)> create; // its path may lack keys; none: not supported
    std::function<void(const Object_Path&)> remove;     // CIM_ERR_NOT_FOUND too; none: not supported
};

} // namespace cimserver
