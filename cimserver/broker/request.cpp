#include "cimserver/broker/request.h"

namespace cimserver
{
namespace
{

thread_local const Request_User* current_user = nullptr;

} // namespace

Request_User::Request_User(std::string name) : _name(std::move(name)), _outer(current_user) { current_user = this; }

Request_User::~Request_User() { current_user = _outer; }

std::string Request_User::current() { return current_user ? current_user->_name : "root"; }

Request::Request(CMPIFlags flags) : _context(make<Context_Object>())
{
    _context.entries.push_back({CMPIInvocationFlags, {CMPI_uint32, std::uint64_t{flags}}});
    _context.entries.push_back({CMPIPrincipal, {CMPI_string, Request_User::current()}});
}

} // namespace cimserver
