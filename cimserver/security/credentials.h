// Credentials: tells whether a name and a password are those of a user of the file (HTTP Basic, RFC 7617).
//
// A hash that resists guessing is expensive, and clients send their password with every request. So a login that was good
// is remembered by a digest (HMAC-SHA-256) whose key is drawn at random and never leaves the process; there is at most one
// per user. The expensive check is apart, for the caller to bound. Names that do not exist cost it too, so that nobody learns
// from the time it takes which do.
//
// The file is looked at with each check and read again when it has changed; all that was remembered is then forgotten. While
// it cannot be read or is damaged nobody is let in, and standard error tells why.
#pragma once

#include "cimserver/security/basic_login.h"
#include "cimserver/security/user_file.h"

#include <array>
#include <mutex>
#include <set>
#include <string>

namespace cimserver
{

// Safe to use from several threads at once.
class Credentials
{
public:
    // Throws std::runtime_error when the file cannot be read, is damaged or names no user.
    explicit Credentials(std::string file);
    Credentials(const Credentials&) = delete;
    Credentials& operator=(const Credentials&) = delete;

    // Reads the file again, whatever it looks like. Throws as the constructor does; nobody is let in then.
    void reload();

    bool remembers(const Login& login); // quick
    bool verify(const Login& login);    // tens of milliseconds

private:
    using Digest = std::array<unsigned char, 32>;
    using Stamp = std::array<long long, 7>; // what tells one state of the file from another

    static Stamp stamp_of(const std::string& file);
    Digest digest(const Login& login) const;
    void read(const Stamp& stamp);
    void refresh();

    const std::string _file;
    Digest _key;
    std::mutex _mutex;
    Stamp _stamp{};
    Users _users;
    std::string _decoy; // the hash that an unknown user is checked against
    std::set<Digest> _verified;
};

} // namespace cimserver
