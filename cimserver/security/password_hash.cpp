#include "cimserver/security/password_hash.h"

#include <crypt.h>
#include <gnutls/gnutls.h>

#include <cstring>
#include <memory>
#include <stdexcept>

namespace cimserver
{
namespace
{

// Empty when libcrypt refuses.
std::string crypt_text(const std::string& password, const std::string& setting)
{
    const auto data = std::make_unique<crypt_data>(); // 32 KB, too large for a stack
    const char* hash = crypt_r(password.c_str(), setting.c_str(), data.get());
    const std::string text = hash && hash[0] != '*' ? hash : "";
    gnutls_memset(data.get(), 0, sizeof *data);
    return text;
}

} // namespace

std::string hash_password(const std::string& password)
{
    char setting[CRYPT_GENSALT_OUTPUT_SIZE];
    if (!crypt_gensalt_rn("$y$", 0, nullptr, 0, setting, sizeof setting))
        throw std::runtime_error("cannot make a salt");
    const std::string hash = crypt_text(password, setting);
    if (hash.empty())
        throw std::runtime_error("cannot hash the password");
    return hash;
}

bool matches_hash(const std::string& password, const std::string& hash)
{
    const std::string mine = crypt_text(password, hash);
    return mine.size() == hash.size() && gnutls_memcmp(mine.data(), hash.data(), hash.size()) == 0;
}

bool is_password_hash(const std::string& text)
{
    return (text.starts_with("$y$") || text.starts_with("$6$")) && crypt_checksalt(text.c_str()) == CRYPT_SALT_OK;
}

} // namespace cimserver
