#include "cimserver/broker/request.h"

#include <iterator>
#include <utility>

namespace cimserver
{
namespace
{

thread_local Text user_of_thread = "root";

} // namespace

Principal_Scope::Principal_Scope(const std::string& user) : _before(std::exchange(user_of_thread, Text(user))) {}

Principal_Scope::~Principal_Scope() { user_of_thread = _before; }

const Text& Principal_Scope::current() { return user_of_thread; }

Request::Request(CMPIFlags flags) : _context(make<Context_Object>())
{
    static const Name names[] = {CMPIInvocationFlags, CMPIPrincipal};
    _context.entries.reserve(std::size(names));
    _context.entries.push_back({names[0], {CMPI_uint32, std::uint64_t{flags}}});
    _context.entries.push_back({names[1], {CMPI_string, Principal_Scope::current()}});
}

} // namespace cimserver
