// Who this server is, as paths and its own objects tell it.
#pragma once

#include <string>

namespace cimserver
{

std::string host_name(); // "localhost" when the system tells none
const char* version();   // the project's, "major.minor.patch"

} // namespace cimserver
