#include "runtime/regular_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace zmlr
{

int open_regular(const char* path, int flags, mode_t mode) noexcept
{
    const int fd = open(path, flags | O_CLOEXEC | O_NONBLOCK | O_NOCTTY, mode);
    struct stat status;
    if (fd < 0 || (fstat(fd, &status) == 0 && S_ISREG(status.st_mode)))
        return fd;
    close(fd);
    return -1;
}

} // namespace zmlr
