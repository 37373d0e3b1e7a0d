#include "cimserver/broker/request.h"

namespace cimserver
{

Request::Request(CMPIFlags flags) : _context(make<Context_Object>())
{
    _context.entries.push_back({CMPIInvocationFlags, {CMPI_uint32, std::uint64_t{flags}}});
    _context.entries.push_back({CMPIPrincipal, {CMPI_string, "root"}}); // clients are not told apart on loopback
}

} // namespace cimserver
