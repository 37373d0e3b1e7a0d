#include "cimserver/broker/request.h"

#include "cimserver/model/principal.h"

namespace cimserver
{

Request::Request(CMPIFlags flags) : _context(make<Context_Object>())
{
    _context.entries.push_back({CMPIInvocationFlags, {CMPI_uint32, std::uint64_t{flags}}});
    _context.entries.push_back({CMPIPrincipal, {CMPI_string, Principal_Scope::current()}});
}

} // namespace cimserver
