#include "cimserver/security/credentials.h"

#include "cimserver/security/password_hash.h"

#include <gnutls/crypto.h>
#include <sys/stat.h>

#include <cstdio>
#include <stdexcept>
#include <utility>

namespace cimserver
{

Credentials::Credentials(std::string file) : _file(std::move(file))
{
    if (gnutls_rnd(GNUTLS_RND_KEY, _key.data(), _key.size()) != 0)
        throw std::runtime_error("cannot draw a random key");
    read(stamp_of(_file));
    _decoy = _users.begin()->second;
}

Credentials::Stamp Credentials::stamp_of(const std::string& file)
{
    struct stat status = {};
    stat(file.c_str(), &status);
    return {static_cast<long long>(status.st_dev),
            static_cast<long long>(status.st_ino),
            status.st_size,
            status.st_mtim.tv_sec,
            status.st_mtim.tv_nsec,
            status.st_ctim.tv_sec,
            status.st_ctim.tv_nsec};
}

// The stamp is older than what is read: a change in between is then seen.
void Credentials::read(const Stamp& stamp)
{
    _stamp = stamp;
    _verified.clear();
    _users.clear();
    Users users = read_users(_file);
    if (users.empty())
        throw std::runtime_error(_file + " names no user");
    _users = std::move(users);
}

void Credentials::refresh()
try
{
    const Stamp stamp = stamp_of(_file);
    if (stamp != _stamp)
        read(stamp);
}
catch (const std::runtime_error& error)
{
    std::fprintf(stderr, "zmlr-cimserver: %s; nobody is let in until this is mended\n", error.what());
}

void Credentials::reload()
{
    const std::lock_guard lock(_mutex);
    read(stamp_of(_file));
}

Credentials::Digest Credentials::digest(const Login& login) const
{
    const std::string text = login.name + ":" + login.password; // a name holds no colon
    Digest digest{};
    if (gnutls_hmac_fast(GNUTLS_MAC_SHA256, _key.data(), _key.size(), text.data(), text.size(), digest.data()) != 0)
        throw std::runtime_error("cannot compute a digest");
    return digest;
}

bool Credentials::remembers(const Login& login)
{
    const Digest wanted = digest(login);
    const std::lock_guard lock(_mutex);
    refresh();
    return _verified.contains(wanted);
}

// The hash is computed without the lock; what is verified against a file that has changed meanwhile is not remembered.
bool Credentials::verify(const Login& login)
{
    const Digest wanted = digest(login);
    std::unique_lock lock(_mutex);
    refresh();
    if (_verified.contains(wanted))
        return true;
    const Stamp stamp = _stamp;
    const auto user = _users.find(login.name);
    const bool known = user != _users.end();
    const std::string hash = known ? user->second : _decoy;
    lock.unlock();

    const bool good = matches_hash(login.password, hash) && known;

    lock.lock();
    if (good && stamp == _stamp)
        _verified.insert(wanted);
    return good;
}

} // namespace cimserver
