// A tar archive in the "ustar" format of POSIX.1-1988, read member by member.
//
// Each member is a header of 512 bytes and its data, padded to a multiple of 512 bytes.
#pragma once

#include "hxal/internal/image.h"

#include <string>

namespace hxal
{

struct Tar_Member
{
    std::string name; // as in the header's name field, at most 100 characters
    Image data;
};

// Reads members one after the other from an open file, wherever that stands.
class Tar_Reader
{
public:
    explicit Tar_Reader(int fd) : _fd(fd) {}

    // The next member. HXA_STATUS_BAD_FILE when there is none: the file ends within it, or this is no header. A size that the
    // rest of the file cannot hold is found before memory is spent on it; what the file could hold but no card would is
    // HXA_STATUS_ENOMEM. Throws std::bad_alloc.
    hxa_status_t next(Tar_Member& member);

private:
    bool holds(uint64_t size) const;

    int _fd;
};

} // namespace hxal
