#include "bench/meter.h"

#include <dlfcn.h>
#include <malloc.h>
#include <netdb.h>
#include <sys/ioctl.h>

#include <cstdarg>
#include <cstdlib>
#include <new>
#include <utility>

namespace
{

struct State
{
    bool watches_memory = false;
    bool counts = false;
    std::ptrdiff_t in_use = 0; // since the watch began; below 0 when it ends what was made before
    std::ptrdiff_t peak = 0;
};

thread_local constinit State state;

// What a block takes of the heap: its size stands before it.
std::ptrdiff_t size_of(void* block) { return static_cast<std::ptrdiff_t>(malloc_usable_size(block) + sizeof(std::size_t)); }

template <class Call> int resting(Call call)
{
    if (state.counts)
        CALLGRIND_TOGGLE_COLLECT;
    const bool watched = std::exchange(state.watches_memory, false);
    const int result = call();
    state.watches_memory = watched;
    if (state.counts)
        CALLGRIND_TOGGLE_COLLECT;
    return result;
}

} // namespace

namespace bench
{

Memory_Meter::Memory_Meter() { state = {.watches_memory = true}; }

Memory_Meter::~Memory_Meter() { state = {}; }

std::size_t Memory_Meter::peak() const { return static_cast<std::size_t>(state.peak); }

Counted::Counted()
{
    state.counts = true;
    CALLGRIND_TOGGLE_COLLECT;
}

Counted::~Counted()
{
    CALLGRIND_TOGGLE_COLLECT;
    state.counts = false;
}

} // namespace bench

// The allocations of the program and of the module alike: all of ours are made with new.

void* operator new(std::size_t size)
{
    void* block = std::malloc(size);
    if (!block)
        throw std::bad_alloc();
    if (state.watches_memory)
    {
        state.in_use += size_of(block);
        if (state.in_use > state.peak)
            state.peak = state.in_use;
    }
    return block;
}

void operator delete(void* block) noexcept
{
    if (block && state.watches_memory)
        state.in_use -= size_of(block);
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept { operator delete(block); }

// The meters rest in what belongs to the machine: while the driver answers (this stands before the simulator's)...
extern "C" [[gnu::visibility("default")]] int ioctl(int descriptor, unsigned long request, ...) noexcept
{
    static const auto driver = reinterpret_cast<int (*)(int, unsigned long, ...)>(dlsym(RTLD_NEXT, "ioctl"));
    va_list arguments;
    va_start(arguments, request);
    void* record = va_arg(arguments, void*);
    va_end(arguments);

    return resting([&] { return driver(descriptor, request, record); });
}

// ...and while the resolver looks up the host's name, in a file or on the network.
extern "C" [[gnu::visibility("default")]] int gethostbyname_r(const char* name, hostent* entry, char* room, std::size_t size,
                                                              hostent** found, int* error)
{
    static const auto resolver = reinterpret_cast<decltype(&gethostbyname_r)>(dlsym(RTLD_NEXT, "gethostbyname_r"));
    return resting([&] { return resolver(name, entry, room, size, found, error); });
}
