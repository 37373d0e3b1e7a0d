// File_Lock: a whole-file write lock that keeps processes apart which share a file (POSIX record locks).
//
// Record locks belong to a process: they do not keep its own threads apart, and closing any descriptor of the file drops
// them. Lock with a mutex held, and let nothing else open the lock file.
#pragma once

#include <fcntl.h>

namespace zmlr
{

struct File_Lock_Rep
{
    struct flock lock;
    struct flock unlock;
    int fd;
};

class File_Lock
{
public:
    explicit File_Lock(const char* path) noexcept; // opens the file, creating it (mode 0600) if needed
    ~File_Lock();
    File_Lock(const File_Lock&) = delete;
    File_Lock& operator=(const File_Lock&) = delete;

    bool okay() const { return _rep.fd >= 0; } // whether the file could be opened

    // Both return 0, or -1 when the system refuses. lock() waits for as long as another process holds the lock.
    int lock();
    int unlock();

private:
    File_Lock_Rep _rep;
};

} // namespace zmlr
