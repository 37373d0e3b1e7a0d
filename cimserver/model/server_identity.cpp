#include "cimserver/model/server_identity.h"

#include <unistd.h>

namespace cimserver
{

std::string host_name()
{
    char name[256] = "";
    if (gethostname(name, sizeof name - 1) != 0 || name[0] == '\0')
        return "localhost";
    return name;
}

const char* version() { return ZMLR_VERSION; }

} // namespace cimserver
