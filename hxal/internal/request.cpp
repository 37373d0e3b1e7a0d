#include "hxal/internal/request.h"

#include "hxal/library.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <sys/ioctl.h>

hxa_status_t hxal::transfer(const hxal_s& ioc, const Command& command, void* record)
{
    const bool ethernet = ioc.ioc_type == HXA_IOC_TYPE_LL;
    const uint32_t code = command_code(command, ethernet ? command.family.ll : command.family.fc);

    // The Ethernet driver may answer a positive number, which leaves errno alone: an older error must not show through.
    errno = 0;
    const int result = ::ioctl(ioc.fd, code, record);
    const bool failed = ethernet ? result != 0 : result == -1;
    return failed ? hxal_get_status(errno) : HXA_STATUS_OK;
}

void hxal::tell_failure(const Command& command)
{
    std::printf("IOCTL ERR  %.*s   %s\n", static_cast<int>(command.name.size()), command.name.data(), std::strerror(errno));
}
