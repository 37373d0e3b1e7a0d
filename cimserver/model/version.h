#pragma once

namespace cimserver
{

// The project's version, "major.minor.patch".
const char* version();

} // namespace cimserver
