#include "cimserver/broker/request.h"

#include "cimserver/model/principal.h"

namespace cimserver
{

Request::Request(CMPIFlags flags) : _context(make<Context_Object>())
{
    put(_context.entries, CMPIInvocationFlags, {CMPI_uint32, std::uint64_t{flags}});
    put(_context.entries, CMPIPrincipal, {CMPI_string, Principal_Scope::current()});
}

} // namespace cimserver
