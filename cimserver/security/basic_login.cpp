#include "cimserver/security/basic_login.h"

#include "cimserver/model/names.h"

#include <gnutls/gnutls.h>

namespace cimserver
{
namespace
{

// Nothing when the text is no base64.
std::optional<std::string> decoded(std::string text)
{
    const gnutls_datum_t base64{reinterpret_cast<unsigned char*>(text.data()), static_cast<unsigned>(text.size())};
    gnutls_datum_t result{};
    if (text.empty() || gnutls_base64_decode2(&base64, &result) != GNUTLS_E_SUCCESS)
        return std::nullopt;
    std::string bytes(reinterpret_cast<const char*>(result.data), result.size);
    gnutls_free(result.data);
    return bytes;
}

} // namespace

std::optional<Login> read_basic_login(std::string_view authorization)
{
    const std::size_t scheme = authorization.find(' ');
    const std::size_t token = authorization.find_first_not_of(' ', scheme);
    if (token == std::string_view::npos || !equal_names(authorization.substr(0, scheme), "Basic"))
        return std::nullopt;
    const auto text = decoded(std::string(authorization.substr(token)));
    const std::size_t colon = text ? text->find(':') : std::string::npos;
    if (colon == std::string::npos || text->find('\0') != std::string::npos)
        return std::nullopt;
    return Login{text->substr(0, colon), text->substr(colon + 1)};
}

} // namespace cimserver
