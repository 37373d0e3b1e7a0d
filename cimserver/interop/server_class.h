// Server_Class: a class whose instances are the server's own, in the interop name space.
#pragma once

#include "cimserver/broker/model.h"
#include "runtime/meta.h"

#include <optional>
#include <vector>

namespace cimserver
{

// Called on several threads at once. Interop_Operations checks a request before it comes here: paths have all the keys of the
// class, typed; instances hold only properties of the class, typed. Every function may throw Cim_Error.
//
// An answer may leave properties out that are null, and the name space of its path; it names the class itself.
class Server_Class
{
public:
    Server_Class() = default;
    virtual ~Server_Class() = default;
    Server_Class(const Server_Class&) = delete;
    Server_Class& operator=(const Server_Class&) = delete;

    virtual const zmlr::Meta_Class& meta_class() const = 0; // one of server_schema.h
    virtual std::vector<Instance> enumerate() = 0;

    // The instance that the path names; nothing when there is none. Found by enumeration unless a class knows better.
    virtual std::optional<Instance> get(const Object_Path& path);

    // CIM_ERR_NOT_SUPPORTED unless a class can do it. Nothing of the server's can be modified.
    virtual Object_Path create(const Instance& instance); // its path may lack keys
    virtual void remove(const Object_Path& path);         // CIM_ERR_NOT_FOUND too
};

} // namespace cimserver
