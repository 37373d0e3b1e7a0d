// Opening and reading the file, which may be anything.
#include "hxal/config/parser.h"
#include "hxal/config/syntax.h"

#include <algorithm>
#include <cstdio>
#include <fcntl.h>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

constexpr int line_size = 512;

// Far more than the model holds: 128 entries with every setting and 255 virtual ports each.
constexpr off_t largest_file = 16 << 20;

struct Close
{
    void operator()(std::FILE* file) const { std::fclose(file); }
};

using File = std::unique_ptr<std::FILE, Close>;

struct Opened
{
    File file;
    off_t size = 0;
};

// Not blocking: a FIFO would wait for its writer before it could be refused.
Opened open_regular(const char* path)
{
    const int descriptor = path ? ::open(path, O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK) : -1;
    if (descriptor < 0)
        return {};
    struct stat status;
    if (::fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode))
        if (std::FILE* file = ::fdopen(descriptor, "r"))
            return {File(file), status.st_size};
    ::close(descriptor);
    return {};
}

} // namespace

hxa_status_t hxal_config_load(const char* path)
{
    const auto [file, size] = open_regular(path);
    if (!file)
        return HXA_STATUS_OK;
    const off_t end = std::min(size, largest_file);
    char line[line_size];
    for (off_t read = 0; read < end;)
    {
        const int length = hxal_getline(line, line_size, file.get());
        if (length == 0)
            break;
        if (line[0] != '#')
            hxal_config_parse(line);
        read += length;
    }
    return HXA_STATUS_OK;
}
