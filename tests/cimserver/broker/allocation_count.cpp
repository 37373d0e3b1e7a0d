#include "allocation_count.h"

#include <atomic>
#include <cstdlib>
#include <new>

namespace
{

std::atomic<long> live = 0;

} // namespace

long live_allocations() { return live; }

void* operator new(std::size_t size, const std::nothrow_t&) noexcept
{
    void* block = std::malloc(size != 0 ? size : 1);
    if (block)
        live.fetch_add(1, std::memory_order_relaxed);
    return block;
}

void* operator new(std::size_t size)
{
    if (void* block = operator new(size, std::nothrow))
        return block;
    throw std::bad_alloc();
}

void operator delete(void* block) noexcept
{
    if (!block)
        return;
    live.fetch_sub(1, std::memory_order_relaxed);
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept { operator delete(block); }
