// The file of the users who may use the server: one "name:hash" a line (password_hash.h), mode 0600 or 0640.
#pragma once

#include <map>
#include <string>

namespace cimserver
{

using Users = std::map<std::string, std::string>; // name, hash

inline constexpr std::size_t max_user_file_bytes = std::size_t{1} << 20;

// Whether a text can be a user's name: 1 to 64 bytes, no colon (HTTP Basic separates with it), no control character.
bool is_user_name(const std::string& name);

// Throws std::runtime_error that tells why a text can be no password: it is empty, longer than libcrypt takes, or holds a
// control character.
void check_password(const std::string& password);

// The users of a file. Throws std::runtime_error that names the file, and the line that is no user.
Users read_users(const std::string& file);

// Adds a user to the file, or gives one a new password. A missing file is made, and so is its folder (mode 0700). Throws
// std::runtime_error, and changes nothing, when the name or the password will not do, the file is not sound, or it cannot be
// written.
void store_user(const std::string& file, const std::string& name, const std::string& password);

} // namespace cimserver
