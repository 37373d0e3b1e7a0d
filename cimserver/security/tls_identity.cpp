#include "cimserver/security/tls_identity.h"

#include "cimserver/security/private_file.h"

#include <gnutls/gnutls.h>

#include <fstream>
#include <iterator>
#include <memory>
#include <stdexcept>

namespace cimserver
{
namespace
{

constexpr std::size_t max_pem_bytes = std::size_t{1} << 20;

struct Free_Credentials
{
    void operator()(gnutls_certificate_credentials_t credentials) const { gnutls_certificate_free_credentials(credentials); }
};
using Certificate_Credentials = std::unique_ptr<std::remove_pointer_t<gnutls_certificate_credentials_t>, Free_Credentials>;

// A certificate is no secret: whoever may read it does not matter.
std::string read_public_file(const std::string& file)
{
    std::ifstream stream(file, std::ios::binary);
    std::string text;
    text.resize(max_pem_bytes);
    stream.read(text.data(), static_cast<std::streamsize>(text.size()));
    text.resize(static_cast<std::size_t>(stream.gcount()));
    if (text.empty())
        throw std::runtime_error("cannot read " + file);
    return text;
}

gnutls_datum_t datum(const std::string& text)
{
    return {reinterpret_cast<unsigned char*>(const_cast<char*>(text.data())), static_cast<unsigned>(text.size())};
}

void check_pair(const Tls_Identity& identity, const std::string& certificate_file, const std::string& key_file)
{
    gnutls_certificate_credentials_t made = nullptr;
    if (gnutls_certificate_allocate_credentials(&made) != GNUTLS_E_SUCCESS)
        throw std::bad_alloc();
    const Certificate_Credentials credentials(made);
    const gnutls_datum_t certificate = datum(identity.certificate);
    const gnutls_datum_t key = datum(identity.key);
    const int result = gnutls_certificate_set_x509_key_mem2(made, &certificate, &key, GNUTLS_X509_FMT_PEM, nullptr, 0);
    if (result < 0)
        throw std::runtime_error(certificate_file + " and " + key_file + ": " + gnutls_strerror(result));
}

} // namespace

Tls_Identity read_tls_identity(const std::string& certificate_file, const std::string& key_file)
{
    Tls_Identity identity{read_public_file(certificate_file),
                          read_private_file(key_file, max_pem_bytes, File_Privacy::group_may_read)};
    check_pair(identity, certificate_file, key_file);
    return identity;
}

} // namespace cimserver
