// Shell commands: how this module runs the few that it needs.
#pragma once

#include <chrono>
#include <cstddef>

namespace zmlr
{

// The start of what a command prints: its first line, without the line feed, cut where the room ends.
struct First_Line
{
    char text[129] = {};
};

// Runs the command by "/bin/sh -c" and waits until it ends, at most for `limit`; then it is killed with all that it started, but
// for what left its process group. What runs in the background when the command ends in time is left running. Its exit status;
// -1 when it has none: it could not be started, a signal ended it, it took too long, or somebody killed the process between this
// one and the command, which then may go on.
//
// The command reads nothing, inherits no descriptor, no blocked or ignored signal, and may write files of at most 128 MiB, which
// only the user of the process may open. What it prints is thrown away but for the first line, when one is asked for: behind it
// nobody reads, and SIGPIPE may end it.
// Whatever the process does with SIGCHLD, its handler included, the status is known. Any thread may call it.
int run_shell_command(const char* command, std::chrono::seconds limit, First_Line* first_line = nullptr);

} // namespace zmlr
