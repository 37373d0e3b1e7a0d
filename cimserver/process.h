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

// systemd, when it started the program as a service that tells when it is ready. Made before there are threads: it takes the
// address out of the environment, so that no program that the module starts speaks for the server.
class Service_Manager
{
public:
    Service_Manager();
    void tell_ready() const; // does nothing where nobody wants to know

private:
    std::string _socket;
};

} // namespace cimserver
