// What the server asks of its process: descriptors, signals, and who started it as a service.
#pragma once

#include <cstddef>
#include <string>

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

// The address at which systemd waits to hear that the server is ready; empty when nobody waits. Asked before there are threads:
// it is taken out of the environment, so that no program that the module starts speaks for the server.
std::string take_service_manager();
void tell_ready(const std::string& service_manager);

} // namespace cimserver
