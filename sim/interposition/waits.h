// The sleeps of the process, which it may have shortened.
#pragma once

#include <chrono>

namespace hxasim
{

// How long the process has asked to sleep since the last call, before any shortening.
std::chrono::nanoseconds take_slept();

} // namespace hxasim
