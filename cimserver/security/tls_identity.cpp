#include "cimserver/security/tls_identity.h"

#include "cimserver/security/private_file.h"

#include <gnutls/abstract.h>
#include <gnutls/x509.h>

#include <algorithm>
#include <array>
#include <ctime>
#include <fstream>
#include <iterator>
#include <memory>
#include <mutex>
#include <stdexcept>

namespace cimserver
{
namespace
{

constexpr std::size_t max_pem_bytes = std::size_t{1} << 20;
constexpr unsigned max_chain = 16;

template <class Pointer> using Freed = std::unique_ptr<std::remove_pointer_t<Pointer>, void (*)(Pointer)>;
using Certificate = Freed<gnutls_x509_crt_t>;
using Private_Key = Freed<gnutls_x509_privkey_t>;

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

// The first certificate of a text; null when there is none.
Certificate first_certificate(const std::string& text)
{
    gnutls_x509_crt_t made = nullptr;
    if (gnutls_x509_crt_init(&made) != GNUTLS_E_SUCCESS)
        throw std::bad_alloc();
    Certificate certificate(made, gnutls_x509_crt_deinit);
    const gnutls_datum_t pem = datum(text);
    if (gnutls_x509_crt_import(made, &pem, GNUTLS_X509_FMT_PEM) != GNUTLS_E_SUCCESS)
        certificate.reset();
    return certificate;
}

Private_Key private_key(const std::string& text)
{
    gnutls_x509_privkey_t made = nullptr;
    if (gnutls_x509_privkey_init(&made) != GNUTLS_E_SUCCESS)
        throw std::bad_alloc();
    Private_Key key(made, gnutls_x509_privkey_deinit);
    const gnutls_datum_t pem = datum(text);
    if (gnutls_x509_privkey_import2(made, &pem, GNUTLS_X509_FMT_PEM, nullptr, 0) != GNUTLS_E_SUCCESS)
        key.reset();
    return key;
}

// Both have the same number when they belong together.
using Key_Id = std::array<unsigned char, 32>;

template <class Function, class Owner> Key_Id key_id_of(Function get_key_id, const Owner& owner)
{
    Key_Id id{};
    std::size_t size = id.size();
    get_key_id(owner.get(), GNUTLS_KEYID_USE_SHA256, id.data(), &size);
    return id;
}

std::string date_text(std::time_t time)
{
    char text[32] = "";
    std::tm fields{};
    gmtime_r(&time, &fields);
    std::strftime(text, sizeof text, "%Y-%m-%d %H:%M UTC", &fields);
    return text;
}

std::mutex shown_mutex;
std::shared_ptr<const Tls_Identity> shown;

int retrieve(gnutls_session_t, const gnutls_cert_retr_st*, gnutls_pcert_st** certificates, unsigned* count, gnutls_ocsp_data_st**,
             unsigned* ocsp_count, gnutls_privkey_t* key, unsigned* flags)
{
    std::shared_ptr<const Tls_Identity> identity;
    {
        const std::lock_guard lock(shown_mutex);
        identity = shown;
    }
    const gnutls_datum_t certificate_pem = datum(identity->certificate);
    const gnutls_datum_t key_pem = datum(identity->key);
    std::unique_ptr<gnutls_pcert_st, gnutls_free_function> list(
        static_cast<gnutls_pcert_st*>(gnutls_malloc(max_chain * sizeof(gnutls_pcert_st))), gnutls_free);
    *count = max_chain;
    *ocsp_count = 0;
    if (!list || gnutls_pcert_list_import_x509_raw(list.get(), count, &certificate_pem, GNUTLS_X509_FMT_PEM, 0) < 0 ||
        gnutls_privkey_init(key) < 0 || gnutls_privkey_import_x509_raw(*key, &key_pem, GNUTLS_X509_FMT_PEM, nullptr, 0) < 0)
        return -1; // memory is out: both were sound when they were read
    *certificates = list.release();
    *flags = GNUTLS_CERT_RETR_DEINIT_ALL;
    return 0;
}

} // namespace

Tls_Identity read_tls_identity(const std::string& certificate_file, const std::string& key_file)
{
    Tls_Identity identity{read_public_file(certificate_file),
                          read_private_file(key_file, max_pem_bytes, File_Privacy::group_may_read)};
    const Certificate certificate = first_certificate(identity.certificate);
    if (!certificate)
        throw std::runtime_error(certificate_file + " holds no certificate in PEM form");
    const Private_Key key = private_key(identity.key);
    if (!key)
        throw std::runtime_error(key_file + " holds no private key in PEM form without a password");
    if (key_id_of(gnutls_x509_crt_get_key_id, certificate) != key_id_of(gnutls_x509_privkey_get_key_id, key))
        throw std::runtime_error(key_file + " is not the key of the certificate " + certificate_file);
    return identity;
}

std::vector<std::string> weaknesses_of(const Tls_Identity& identity)
{
    const Certificate certificate = first_certificate(identity.certificate);
    std::vector<std::string> found;
    const std::time_t now = std::time(nullptr);
    const std::time_t begin = gnutls_x509_crt_get_activation_time(certificate.get());
    const std::time_t end = gnutls_x509_crt_get_expiration_time(certificate.get());
    if (now < begin)
        found.push_back("it is not valid before " + date_text(begin));
    if (now > end)
        found.push_back("it has expired on " + date_text(end));
    unsigned bits = 0;
    const auto algorithm = static_cast<gnutls_pk_algorithm_t>(gnutls_x509_crt_get_pk_algorithm(certificate.get(), &bits));
    if (gnutls_pk_bits_to_sec_param(algorithm, bits) < GNUTLS_SEC_PARAM_MEDIUM)
        found.push_back("its key is weak (" + std::string(gnutls_pk_get_name(algorithm)) + " of " + std::to_string(bits) +
                        " bits)");
    return found;
}

void show_identity(Tls_Identity identity)
{
    auto next = std::make_shared<const Tls_Identity>(std::move(identity));
    const std::lock_guard lock(shown_mutex);
    shown = std::move(next);
}

void* identity_callback() { return reinterpret_cast<void*>(&retrieve); }

} // namespace cimserver
