// What the server asks of its process: descriptors and signals.
#pragma once

#include <cstddef>

namespace cimserver
{

// Standard descriptors that whoever started the program left closed are opened on "/dev/null": the next files and connections
// must not be taken for them.
void open_standard_descriptors();

// Raises the limit of open files as far as it may, for this many connections. Throws std::runtime_error that tells how to help
// when that is not enough.
void reserve_descriptors(std::size_t connections);

enum class Wish
{
    stop,  // SIGTERM, SIGINT
    reload // SIGHUP
};

// From now on no signal that others send ends the process: it waits for its wish to be taken, or does nothing.
void handle_signals();
Wish next_wish(); // waits for one

} // namespace cimserver
