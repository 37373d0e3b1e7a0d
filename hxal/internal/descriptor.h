// An open device node or file.
#pragma once

#include <fcntl.h>
#include <unistd.h>

namespace hxal
{

// Opens a path, for reading and writing unless the flags of open(2) say otherwise, and closes it at the end. is_open() tells
// whether it could.
class Descriptor
{
public:
    explicit Descriptor(const char* path, int flags = O_RDWR, mode_t mode = 0) : _fd(::open(path, flags | O_CLOEXEC, mode)) {}

    ~Descriptor()
    {
        if (is_open())
            ::close(_fd);
    }

    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    bool is_open() const { return _fd >= 0; }
    int number() const { return _fd; }

private:
    int _fd;
};

} // namespace hxal
