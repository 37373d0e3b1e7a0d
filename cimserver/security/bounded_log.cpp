#include "cimserver/security/bounded_log.h"

#include "text/safe_text.h"

#include <cstdio>

namespace cimserver
{
namespace
{

constexpr std::size_t longest_name = 64; // of any user

} // namespace

std::string printable_name(const std::string& name)
{
    std::string text;
    for (const char c : name.substr(0, longest_name))
    {
        char escaped[] = "\\x00";
        std::snprintf(escaped, sizeof escaped, "\\x%02X", static_cast<unsigned char>(c));
        const bool plain = c >= ' ' && c <= '~' && c != '"' && c != '\\';
        text += plain ? std::string(1, c) : escaped;
    }
    return name.size() > longest_name ? text + "..." : text;
}

void Bounded_Log::tell(const std::string& line)
{
    const std::lock_guard lock(_mutex);
    const Clock::time_point now = Clock::now();
    if (_lines == 0 || now - _minute >= std::chrono::minutes(1))
    {
        _minute = now;
        _lines = 0;
    }
    if (_lines == lines_a_minute)
    {
        ++_untold;
        return;
    }
    ++_lines;
    if (_untold > 0)
        std::fprintf(stderr, "zmlr-cimserver: %lu %s\n", _untold, _others.c_str());
    _untold = 0;
    std::fprintf(stderr, "zmlr-cimserver: %s\n", text::safe_text(line).c_str());
}

} // namespace cimserver
