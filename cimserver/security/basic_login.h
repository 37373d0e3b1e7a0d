// The name and password that a request's Authorization header carries (HTTP Basic, RFC 7617).
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace cimserver
{

struct Login
{
    std::string name;
    std::string password;
};

// The login in a header's value: the scheme "Basic" in any case, then the base64 of "name:password" in UTF-8. Nothing for any
// other value, and for a password that holds a zero byte: no password does (user_file.h).
std::optional<Login> read_basic_login(std::string_view authorization);

} // namespace cimserver
