#include "sim/driver/event_descriptor.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <cerrno>

namespace hxasim
{

int make_event_descriptor(int flags)
{
    int event_flags = ((flags & O_CLOEXEC) != 0 ? EFD_CLOEXEC : 0) | ((flags & O_NONBLOCK) != 0 ? EFD_NONBLOCK : 0);
    int descriptor = eventfd(0, event_flags);
    return descriptor < 0 ? -errno : descriptor;
}

void make_readable(int descriptor) { eventfd_write(descriptor, 1); }

// The program may have read it already.
void make_unreadable(int descriptor)
{
    pollfd waiting{.fd = descriptor, .events = POLLIN, .revents = 0};
    eventfd_t count = 0;
    if (poll(&waiting, 1, 0) == 1)
        eventfd_read(descriptor, &count);
}

} // namespace hxasim
