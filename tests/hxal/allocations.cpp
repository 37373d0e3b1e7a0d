#include "allocations.h"

#include "hxal/config/model.h"
#include "hxal/internal/list.h"

#include <malloc.h>

#include <cstdlib>
#include <new>

namespace
{

int failing_node = 0;
std::size_t live_bytes = 0;
std::size_t peak_bytes = 0;

bool is_library_node(std::size_t size)
{
    return size == sizeof(hxal::Ioc_Node) || size == sizeof(hxal_adapter_t) || size == sizeof(hxal_vf_config_t);
}

} // namespace

void allocations::fail_library_node(int number) { failing_node = number; }
std::size_t allocations::peak() { return peak_bytes; }
void allocations::reset_peak() { peak_bytes = live_bytes; }

// Not inlined: the compiler would see malloc() through them and take the pairs for mismatched.
[[gnu::noinline]] void* operator new(std::size_t size)
{
    if (failing_node > 0 && is_library_node(size) && --failing_node == 0)
        throw std::bad_alloc();
    void* memory = std::malloc(size);
    if (!memory)
        throw std::bad_alloc();
    live_bytes += malloc_usable_size(memory);
    peak_bytes = live_bytes > peak_bytes ? live_bytes : peak_bytes;
    return memory;
}

// The address sanitizer's would not call the one above.
[[gnu::noinline]] void* operator new(std::size_t size, const std::nothrow_t&) noexcept
try
{
    return operator new(size);
}
catch (const std::bad_alloc&)
{
    return nullptr;
}

[[gnu::noinline]] void operator delete(void* memory) noexcept
{
    live_bytes -= memory ? malloc_usable_size(memory) : 0;
    std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept { operator delete(memory); }
