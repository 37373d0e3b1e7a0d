// What surrounds one call into the module: the arena of its objects, its context, and the user whom it is for.
#pragma once

#include "cimserver/broker/objects.h"

namespace cimserver
{

// From now on the calling thread works for the user, until the end of the scope.
class Principal_Scope
{
public:
    explicit Principal_Scope(const std::string& user);
    ~Principal_Scope();
    Principal_Scope(const Principal_Scope&) = delete;
    Principal_Scope& operator=(const Principal_Scope&) = delete;

    // Whom the calling thread works for; "root", the server itself, outside any scope.
    static const Text& current();

private:
    const Text _before;
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
