// Salted password hashes of libcrypt (crypt(5)): yescrypt, and SHA-512 for files that other tools wrote.
#pragma once

#include <string>

namespace cimserver
{

inline constexpr std::size_t max_password_bytes = 511; // libcrypt's own limit

// A new yescrypt hash with a random salt. Takes tens of milliseconds on purpose. Throws std::runtime_error when libcrypt
// refuses (a password beyond the limit).
std::string hash_password(const std::string& password);

// Whether the password gives the hash; costs the time of the hash whatever the answer.
bool matches_hash(const std::string& password, const std::string& hash);

// Whether a text is a hash of one of the two kinds.
bool is_password_hash(const std::string& text);

} // namespace cimserver
