#include "runtime/file_lock.h"

#include "runtime/regular_file.h"

#include <cerrno>
#include <cstdio>
#include <unistd.h>

namespace zmlr
{

namespace
{

struct flock whole_file(short type)
{
    struct flock request = {};
    request.l_type = type;
    request.l_whence = SEEK_SET;
    return request; // length 0: to the end, however far the file grows
}

int request(int fd, struct flock& lock)
{
    int result = 0;
    do
        result = fcntl(fd, F_SETLKW, &lock);
    while (result != 0 && errno == EINTR);
    return result == 0 ? 0 : -1;
}

} // namespace

File_Lock::File_Lock(const char* path) noexcept
    : _rep{whole_file(F_WRLCK), whole_file(F_UNLCK), open_regular(path, O_WRONLY | O_CREAT, 0600)}
{
}

File_Lock::~File_Lock()
{
    if (okay())
        close(_rep.fd);
}

int File_Lock::lock() { return request(_rep.fd, _rep.lock); }
int File_Lock::unlock() { return request(_rep.fd, _rep.unlock); }

} // namespace zmlr
