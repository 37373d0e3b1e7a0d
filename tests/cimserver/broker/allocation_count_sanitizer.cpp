// The sanitizers bring operators of their own, and hooks to watch them.
#include "allocation_count.h"

#include <sanitizer/allocator_interface.h>

#include <atomic>

namespace
{

std::atomic<long> live = 0;

void count_malloc(const volatile void*, std::size_t) { live.fetch_add(1, std::memory_order_relaxed); }

void count_free(const volatile void* block)
{
    if (block)
        live.fetch_sub(1, std::memory_order_relaxed);
}

[[maybe_unused]] const int installed = __sanitizer_install_malloc_and_free_hooks(count_malloc, count_free);

} // namespace

long live_allocations() { return live; }
