// A file that a client names.
#pragma once

#include "hxal/internal/descriptor.h"

#include <optional>
#include <sys/stat.h>

namespace hxal
{

// Opens a regular file for reading and closes it at the end. Nothing else is opened, since that alone makes some devices do
// something: it starts a watchdog, rewinds a tape. Needs "/proc".
class Regular_File
{
public:
    explicit Regular_File(const char* path);

    bool exists() const { return _place.is_open(); } // whatever it is
    bool is_regular() const { return _file.has_value(); }
    bool is_open() const { return _file && _file->is_open(); }

    // Of an open file: its descriptor, and its size when it was opened.
    int number() const { return _file->number(); }
    off_t size() const { return _status.st_size; }

private:
    Descriptor _place;
    struct stat _status = {};
    std::optional<Descriptor> _file;
};

} // namespace hxal
