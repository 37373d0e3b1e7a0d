// An open device node.
#pragma once

#include <fcntl.h>
#include <unistd.h>

namespace hxal
{

// Opens a node for reading and writing and closes it at the end. is_open() tells whether it could.
class Descriptor
{
public:
    explicit Descriptor(const char* path) : _fd(::open(path, O_RDWR | O_CLOEXEC)) {}

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
