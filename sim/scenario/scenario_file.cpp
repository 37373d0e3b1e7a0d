#include "sim/scenario/scenario.h"

#include <dlfcn.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace hxasim
{

namespace
{

namespace fs = std::filesystem;

constexpr std::uintmax_t max_file_size = 16 * 1024 * 1024;

// The folder that this library was loaded from; empty when the loader does not tell.
fs::path library_folder()
{
    Dl_info info{};
    auto here = reinterpret_cast<const void*>(&read_scenario_file);
    return dladdr(here, &info) != 0 && info.dli_fname ? fs::path(info.dli_fname).parent_path() : fs::path();
}

fs::path shipped(const std::string& name)
{
    auto library = library_folder();
    for (const fs::path& folder : {library / "scenarios", library / HXASIM_INSTALLED_SCENARIOS})
    {
        auto path = folder / (name + ".json");
        std::error_code ignored;
        if (fs::exists(path, ignored))
            return path;
    }
    throw std::runtime_error(name + ": no such shipped scenario");
}

} // namespace

std::string read_scenario_file(const std::string& name_or_path)
{
    auto is_path = name_or_path.find_first_of("/.") != std::string::npos;
    auto path = is_path ? fs::path(name_or_path) : shipped(name_or_path);
    std::error_code error;
    if (!fs::is_regular_file(path, error))
        throw std::runtime_error(path.string() + ": " + (error ? error.message() : "not a regular file"));
    if (fs::file_size(path) > max_file_size)
        throw std::runtime_error(path.string() + ": larger than 16 MiB");
    std::ifstream file(path, std::ios::binary);
    if (!file)
        throw std::runtime_error(path.string() + ": " + std::strerror(errno));
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace hxasim
