// Request: what surrounds one call into the module: the arena of its objects and its context.
#pragma once

#include "cimserver/broker/objects.h"

namespace cimserver
{

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
