// The certificate that a TLS server shows, and its private key.
#pragma once

#include <string>
#include <vector>

namespace cimserver
{

struct Tls_Identity
{
    std::string certificate; // PEM, the server's own first, then those that signed it
    std::string key;         // PEM, not encrypted
};

// Reads both. The key must be readable by nobody but its owner and, as Debian keeps its keys, a group. Throws
// std::runtime_error that names the file at fault: unreadable, no certificate, no key, or a key of another certificate.
Tls_Identity read_tls_identity(const std::string& certificate_file, const std::string& key_file);

// Why clients may refuse the certificate, a sentence each: it is not valid yet or any more, or its key is weak.
std::vector<std::string> weaknesses_of(const Tls_Identity& identity);

// From now on every new connection of this process's servers is shown this one, a sound one.
void show_identity(Tls_Identity identity);

// A gnutls_certificate_retrieve_function3 that hands out what is shown.
void* identity_callback();

// What is accepted of TLS, in GnuTLS's priority language: versions 1.2 and 1.3 with their strong ciphers, and no key exchange
// that lets whoever gets the private key later read what was recorded.
inline constexpr const char* tls_priorities = "SECURE128:-VERS-ALL:+VERS-TLS1.3:+VERS-TLS1.2:-RSA";

} // namespace cimserver
