#include "tests/inventory/fake_host.h"

#include <arpa/inet.h>
#include <netdb.h>
#include <sys/utsname.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace zmlr
{

Fake_Host fake_host;

namespace
{

int answer(const std::optional<std::string>& text, char* out, size_t size)
{
    if (!text)
        return -1;
    std::strncpy(out, text->c_str(), size);
    return 0;
}

// The addresses in the form of a host entry.
void fill(hostent& entry)
{
    static in_addr addresses[4];
    static char* list[5];
    size_t count = 0;
    for (const std::string& text : fake_host.addresses)
    {
        inet_pton(AF_INET, text.c_str(), &addresses[count]);
        list[count] = reinterpret_cast<char*>(&addresses[count]);
        list[++count] = nullptr;
    }
    entry = {.h_name = nullptr, .h_aliases = nullptr, .h_addrtype = AF_INET, .h_length = sizeof(in_addr), .h_addr_list = list};
}

} // namespace

} // namespace zmlr

extern "C" int gethostname(char* out, size_t size) noexcept
{
    if (zmlr::fake_host.name_answers == 0)
        return -1;
    if (zmlr::fake_host.name_answers > 0)
        zmlr::fake_host.name_answers--;
    return zmlr::answer(zmlr::fake_host.name, out, size);
}

extern "C" int uname(utsname* out) noexcept
{
    *out = {};
    return zmlr::answer(zmlr::fake_host.name, out->nodename, sizeof out->nodename - 1);
}

extern "C" int getdomainname(char* out, size_t size) noexcept { return zmlr::answer(zmlr::fake_host.domain, out, size); }

extern "C" int gethostbyname_r(const char*, hostent* entry, char*, size_t size, hostent** result, int* error)
{
    zmlr::fake_host.lookups++;
    *result = nullptr;
    *error = NETDB_INTERNAL;
    if (size < zmlr::fake_host.memory_needed)
        return ERANGE;
    *error = HOST_NOT_FOUND;
    if (zmlr::fake_host.addresses.empty())
        return 0;
    zmlr::fill(*entry);
    *result = entry;
    return 0;
}
