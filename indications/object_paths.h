// The objects that alerts are about, as texts: "//host/root/zemlar:ZEMLAR_FCPort.<keys>". `host` is the host's text
// (host_text.h).
#pragma once

#include "runtime/string.h"

namespace zmlr
{

String getComputerSystemObjectPath(const String& host);
String getFCPortObjectPath(const String& host, const String& wwn);
String getEthernetPortObjectPath(const String& host, const String& mac);

} // namespace zmlr
