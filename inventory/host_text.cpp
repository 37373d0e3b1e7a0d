#include "inventory/host_text.h"

#include "runtime/log.h"
#include "runtime/trace.h"

#include <arpa/inet.h>
#include <netdb.h>
#include <sys/utsname.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";
constexpr std::size_t name_size = 255;
constexpr std::size_t dotted_size = INET_ADDRSTRLEN;

// A name as the system gives it, with a terminator also where the system cut it.
struct Name
{
    char text[name_size + 1] = {};
};

bool read_host_name(Name& name) { return gethostname(name.text, name_size) == 0; }
bool read_domain_name(Name& name) { return getdomainname(name.text, name_size) == 0; }

// The IPv4 addresses of a host, with the memory they live in.
class Address_List
{
public:
    explicit Address_List(const char* host)
    {
        hostent* found = nullptr;
        int error = 0;
        int outcome = gethostbyname_r(host, &_entry, _room, sizeof _room, &found, &error);
        for (std::size_t size = 2 * sizeof _room; outcome == ERANGE && size <= size_limit; size *= 2)
        {
            _memory = std::make_unique_for_overwrite<char[]>(size);
            outcome = gethostbyname_r(host, &_entry, _memory.get(), size, &found, &error);
        }
        if (found && found->h_addrtype == AF_INET && found->h_length == sizeof(in_addr))
            _next = found->h_addr_list;
    }
    Address_List(const Address_List&) = delete; // it points into itself
    Address_List& operator=(const Address_List&) = delete;

    bool empty() const { return !_next || !*_next; }

    // Writes the first address that is none of the loopback network in dotted form; false when there is none.
    bool first_of_network(char (&dotted)[dotted_size])
    {
        constexpr char loopback = 127;
        while (!empty() && **_next == loopback)
            ++_next;
        return !empty() && inet_ntop(AF_INET, *_next, dotted, dotted_size);
    }

private:
    static constexpr std::size_t size_limit = 64 * 1024;

    hostent _entry = {};
    char _room[1024];                // enough for all but the longest lists
    std::unique_ptr<char[]> _memory; // for those
    char** _next = nullptr;
};

Host_Info give(char* buf, std::size_t size, const char* text, Host_Info kind)
{
    strlcpy(buf, text, size);
    return kind;
}

Host_Info give_bare_name(char* buf, std::size_t size, const Name& host)
{
    ZMLR_LOG(LL_INFO, "gethostbyname() FAILED. hostString will have hostname instead of ipAddress");
    return give(buf, size, host.text, HOST_NAME);
}

// For a host that only has loopback addresses.
Host_Info give_full_name(char* buf, std::size_t size, Name host)
{
    strlcpy(buf, host.text, size);
    if (!read_host_name(host))
    {
        ZMLR_LOG(LL_WARN, "gethostname() failed");
        return HOST_NAME;
    }
    strlcpy(buf, host.text, size);

    Name domain;
    if (!read_domain_name(domain))
    {
        ZMLR_LOG(LL_WARN, "getdomainname() failed");
        return HOST_NAME;
    }
    strlcat(buf, ".", size);
    strlcat(buf, domain.text, size);
    if (std::strcmp(buf, "localhost") != 0 && std::strcmp(domain.text, "(none)") != 0)
        return HOST_FULL_NAME;
    return give_bare_name(buf, size, host);
}

} // namespace

String ProviderUtil::getHostName()
{
    const Scope_Trace trace(log_source);
    utsname system = {};
    return uname(&system) == 0 ? String(system.nodename) : String("localhost");
}

Host_Info ProviderUtil::getHostInfo(char* buf, int len)
{
    const Scope_Trace trace(log_source);
    const std::size_t size = len > 0 ? static_cast<std::size_t>(len) : 0;

    Name host;
    if (!read_host_name(host))
    {
        ZMLR_LOG(LL_INFO, "gethostname() FAILED. hostString will be filled with localhost");
        return give(buf, size, "localhost", HOST_LOCALHOST);
    }

    Address_List addresses(host.text);
    if (addresses.empty())
        return give_bare_name(buf, size, host);

    char dotted[dotted_size];
    if (addresses.first_of_network(dotted))
        return give(buf, size, dotted, HOST_IP_ADDRESS);
    return give_full_name(buf, size, host);
}

String ProviderUtil::updateNamespacePath(const String& path)
{
    const Scope_Trace trace(log_source);
    char host[name_size + 1] = {};
    getHostInfo(host, name_size);
    return updateNamespacePath(path, host);
}

String ProviderUtil::updateNamespacePath(const String& path, const String& host)
{
    return String("//") + host + "/root/zemlar:" + path;
}

const Host_Text& Host_Text::look_up() const
{
    if (!_is_known)
        _info = ProviderUtil::getHostInfo(_text, sizeof _text - 1);
    _is_known = true;
    return *this;
}

} // namespace zmlr
