// Request: what surrounds one call into the module: the arena of its objects and its context.
#pragma once

#include "cimserver/broker/objects.h"

#include <string>

namespace cimserver
{

// Names the user for whom the calling thread works while the scope lasts; without one that is "root".
class Request_User
{
public:
    explicit Request_User(std::string name);
    ~Request_User();
    Request_User(const Request_User&) = delete;
    Request_User& operator=(const Request_User&) = delete;

    static std::string current();

private:
    const std::string _name;
    const Request_User* _outer;
};

// Lives on the stack of the thread that calls the module.
class Request
{
public:
    // The context tells the module the invocation flags (CMPIInvocationFlags) and the user (CMPIPrincipal).
    explicit Request(CMPIFlags flags = 0);

    const CMPIContext* context() { return _context.face(); }

private:
    Arena _arena;
    Context_Object& _context;
};

} // namespace cimserver
