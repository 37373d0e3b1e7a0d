// Any bytes as the drivers' configuration file: it is read, and what is written of it has only lines that the grammar knows.
#include "hxal/config/parser.h"
#include "tests/hxal/config_model.h"

#include <cstdint>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

namespace
{

bool is_setting_or_comment(std::string_view line) { return line.empty() || line.front() == '#' || line.find(" = ") != line.npos; }

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    static const int file = ::memfd_create("hxa.conf", 0);
    static const std::string path = "/proc/self/fd/" + std::to_string(file);
    empty_model();
    if (::ftruncate(file, 0) != 0 || ::pwrite(file, data, size, 0) != static_cast<ssize_t>(size))
        __builtin_trap();
    hxal_config_load(path.c_str());

    const std::string text = written();
    for (std::size_t begin = 0, end; (end = text.find('\n', begin)) != text.npos; begin = end + 1)
        if (!is_setting_or_comment(std::string_view(text).substr(begin, end - begin)))
            __builtin_trap();
    return 0;
}
