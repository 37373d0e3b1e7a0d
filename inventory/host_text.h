// The host: its name, and the text by which it is known in the model.
#pragma once

#include "runtime/string.h"

namespace zmlr
{

// What getHostInfo has put into its buffer.
enum Host_Info : int
{
    HOST_IP_ADDRESS = 0, // an IPv4 address other than a loopback one, in dotted form
    HOST_NAME = 2,       // the bare host name
    HOST_LOCALHOST = 3,  // "localhost": the host has no usable name
    HOST_FULL_NAME = 4   // host name and domain name
};

namespace ProviderUtil
{

// The node's name, "localhost" when it has none.
String getHostName();

// Writes the text by which the host is known in the model, cut to `len` bytes with its terminator.
Host_Info getHostInfo(char* buf, int len);

// "//" host "/root/zemlar:" path. Without a host it is looked up.
String updateNamespacePath(const String& path);
String updateNamespacePath(const String& path, const String& host);

} // namespace ProviderUtil

// The host's text for one request of a client: looked up when it is first asked for, and never again.
class Host_Text
{
public:
    const char (&text() const)[256] { return look_up()._text; }
    Host_Info info() const { return look_up()._info; }

private:
    const Host_Text& look_up() const;

    mutable bool _is_known = false;
    mutable Host_Info _info = HOST_LOCALHOST;
    mutable char _text[256] = {};
};

} // namespace zmlr
