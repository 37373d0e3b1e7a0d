// A new password from whoever started the program.
#pragma once

#include <string>

namespace cimserver
{

// From a terminal on standard input: asked twice, without echo; throws std::runtime_error when the two differ or the user
// gives up. From anything else: the first line. Nothing is said of its quality: see check_password().
std::string ask_password();

} // namespace cimserver
