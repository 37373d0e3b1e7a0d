#include "cimserver/broker/request.h"

#include "cimserver/model/principal.h"

#include <iterator>

namespace cimserver
{

Request::Request(CMPIFlags flags) : _context(make<Context_Object>())
{
    static const Name names[] = {CMPIInvocationFlags, CMPIPrincipal};
    _context.entries.reserve(std::size(names));
    _context.entries.push_back({names[0], {CMPI_uint32, std::uint64_t{flags}}});
    _context.entries.push_back({names[1], {CMPI_string, Principal_Scope::current()}});
}

} // namespace cimserver
