// The option file of the log: lines "NAME = value"; lines that begin with "#" are comments.
#pragma once

#include <cstddef>

namespace zmlr
{

inline constexpr std::size_t option_line_size = 1024; // a line's 1023 characters and a terminator

// Copies the value that the first line of the option gives it; false when there is no plain file or no such line in it (16 MB
// are read: no more are anybody's options). The option's name is compared with regard to case; white space around "=" and at the
// line's end does not count.
bool _get_opt_value(const char* path, const char* name, char (&value)[option_line_size]) noexcept;

} // namespace zmlr
