// The command line, taken apart.
#pragma once

#include "cli/session.h"

#include <functional>
#include <string>

namespace hxa
{

struct Command_Line
{
    Common_Options common;
    std::function<void(Session&)> run; // null: there is only `text` to print
    std::string text;                  // help, the version, or what is wrong with the command line
    Exit code = Exit::done;
};

Command_Line read_command_line(int count, const char* const* words);

} // namespace hxa
