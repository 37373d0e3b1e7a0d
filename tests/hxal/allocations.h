// The operator new of a test program: counts what is allocated, and can fail.
#pragma once

#include <cstddef>

namespace allocations
{

// Fails the n-th allocation, from 1, of the library's own list nodes; 0: none.
void fail_library_node(int number);

// The most bytes that were allocated at a time since reset_peak().
std::size_t peak();
void reset_peak();

} // namespace allocations
