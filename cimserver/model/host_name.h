#pragma once

#include <string>

namespace cimserver
{

// This host's name, as paths and the server's own objects tell it; "localhost" when the system tells none.
std::string host_name();

} // namespace cimserver
