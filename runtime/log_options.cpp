#include "runtime/log_options.h"

#include "runtime/ascii.h"
#include "runtime/regular_file.h"
#include "runtime/string.h"

#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <memory>
#include <unistd.h>

namespace zmlr
{

namespace
{

constexpr long max_size = 16L << 20; // bytes: no file of options is longer, and a sparse one of terabytes ends here

using File = std::unique_ptr<std::FILE, int (*)(std::FILE*)>;

// Null for what is no plain file: a pipe would have us wait for its writer, a device may never end.
File open_options(const char* path)
{
    const int fd = open_regular(path, O_RDONLY, 0);
    std::FILE* file = fd < 0 ? nullptr : fdopen(fd, "r");
    if (fd >= 0 && !file)
        close(fd);
    return {file, std::fclose};
}

const char* skip_space(const char* text)
{
    while (ascii::is_space(*text))
        ++text;
    return text;
}

void trim_end(char* line)
{
    std::size_t size = std::strlen(line);
    while (size > 0 && ascii::is_space(line[size - 1]))
        --size;
    line[size] = '\0';
}

// The value when the line is one of the named option, or null.
const char* value_in(const char* line, const char* name)
{
    const std::size_t length = std::strlen(name);
    if (*line == '#' || std::strncmp(line, name, length) != 0)
        return nullptr;
    const char* mark = skip_space(line + length);
    return *mark == '=' ? skip_space(mark + 1) : nullptr;
}

} // namespace

bool _get_opt_value(const char* path, const char* name, char (&value)[option_line_size]) noexcept
{
    const File file = open_options(path);
    char line[option_line_size];
    while (file && std::fgets(line, sizeof(line), file.get()) && std::ftell(file.get()) <= max_size)
    {
        trim_end(line);
        if (const char* found = value_in(line, name))
        {
            strlcpy(value, found, sizeof(value));
            return true;
        }
    }
    return false;
}

} // namespace zmlr
