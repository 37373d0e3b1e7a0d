// What the work of this program takes of memory and, under callgrind, of instructions. A program that links this has its
// allocations watched. The simulated driver and the resolver of host names are no part of the work: what they do and keep
// does not count.
#pragma once

#include <valgrind/callgrind.h>

#include <cstddef>

namespace bench
{

// Watches the allocations of this thread from its making on. One at a time.
class Memory_Meter
{
public:
    Memory_Meter();
    ~Memory_Meter();
    Memory_Meter(const Memory_Meter&) = delete;
    Memory_Meter& operator=(const Memory_Meter&) = delete;

    // The most that was in use of the heap, in bytes beyond what was before; the allocator's own included.
    std::size_t peak() const;
};

// Callgrind (with --collect-atstart=no) counts this thread's instructions while one lives.
class Counted
{
public:
    Counted();
    ~Counted();
    Counted(const Counted&) = delete;
    Counted& operator=(const Counted&) = delete;
};

} // namespace bench
