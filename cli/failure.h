// Why a command ends without having done what it was asked.
#pragma once

#include "hxal/library.h"

#include <stdexcept>
#include <string>

namespace hxa
{

// What the program exits with; its manual page tells the same.
enum class Exit
{
    done = 0,
    refused = 1,         // the driver or the library, or the system
    usage = 2,           // the command line makes no sense
    no_driver = 3,       // none, or one that refuses this library
    no_such_element = 4, // adapter, port, partition
    not_confirmed = 5,   // the question was answered with no, or there was nobody to ask
};

class Failure : public std::runtime_error
{
public:
    Failure(Exit code, const std::string& what) : std::runtime_error(what), _code(code) {}
    Exit code() const { return _code; }

private:
    Exit _code;
};

// The message of a status with its number: "Port is not online (34)".
std::string status_text(hxa_status_t status);

// Throws with exit code 1 unless the status is HXA_STATUS_OK. `what` is what was refused: "port 1/0".
void require(hxa_status_t status, const std::string& what);

} // namespace hxa
