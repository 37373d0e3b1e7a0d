#include "runtime/array.h"

#include "runtime/assert.h"
#include "runtime/capacity.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <functional>
#include <new>
#include <utility>

namespace zmlr
{

namespace
{

constexpr uint32 min_capacity = 8;
constexpr uint32 not_found = 0xFFFFFFFF;

// What arrays without elements point at, one for each element type: never changed, never freed. A record with a dozen
// empty arrays is made without an allocation for any of them.
template <std::size_t... I> constexpr auto make_empty_reps(std::index_sequence<I...>)
{
    return std::array<__Array_Rep, num_types + 1>{
        {{&__cim_array_traits[I], 0, min_capacity, {0}, {}}..., {&__pointer_array_traits, 0, min_capacity, {0}, {}}}};
}

constinit const std::array<__Array_Rep, num_types + 1> empty_reps = make_empty_reps(std::make_index_sequence<num_types>());

bool is_static(const __Array_Rep* rep)
{
    return std::greater_equal<>()(rep, empty_reps.data()) && std::less<>()(rep, empty_reps.data() + empty_reps.size());
}

__Array_Rep* empty_rep(const __Array_Traits* traits)
{
    const std::size_t i = traits == &__pointer_array_traits ? num_types : static_cast<std::size_t>(traits - __cim_array_traits);
    return const_cast<__Array_Rep*>(&empty_reps[i]);
}

unsigned char* at(__Array_Rep* rep, uint32 i) { return rep->data + std::size_t{i} * rep->traits->elem_size; }
const unsigned char* at(const __Array_Rep* rep, uint32 i) { return rep->data + std::size_t{i} * rep->traits->elem_size; }
std::size_t bytes(const __Array_Rep* rep, uint32 n) { return std::size_t{n} * rep->traits->elem_size; }

// A new, empty representation with room for at least n elements.
__Array_Rep* make_rep(const __Array_Traits* traits, std::size_t n)
{
    const uint32 capacity = _next_pow_2(n, min_capacity);
    std::size_t size = 0;
    if (__builtin_mul_overflow(std::size_t{capacity}, std::size_t{traits->elem_size}, &size) ||
        __builtin_add_overflow(size, offsetof(__Array_Rep, data), &size))
        throw std::bad_array_new_length();

    auto* rep = static_cast<__Array_Rep*>(::operator new(size));
    rep->traits = traits;
    rep->size = 0;
    rep->capacity = capacity;
    rep->refs = {1};
    return rep;
}

// Frees the storage alone: the elements have moved or are destructed already.
void free_rep(__Array_Rep* rep)
{
    if (!is_static(rep))
        ::operator delete(rep);
}

void construct(__Array_Rep* rep, uint32 pos, const void* from, uint32 n)
{
    if (n == 0)
        return;
    if (rep->traits->construct)
        rep->traits->construct(at(rep, pos), from, n);
    else if (from)
        std::memcpy(at(rep, pos), from, bytes(rep, n));
    else
        std::memset(at(rep, pos), 0, bytes(rep, n));
}

void destruct(__Array_Rep* rep, uint32 pos, uint32 n)
{
    if (n > 0 && rep->traits->destruct)
        rep->traits->destruct(at(rep, pos), n);
}

bool equal(const __Array_Traits* traits, const void* a, const void* b, uint32 n)
{
    if (n == 0)
        return true;
    return traits->equal ? traits->equal(a, b, n) : std::memcmp(a, b, std::size_t{n} * traits->elem_size) == 0;
}

bool is_own(const __Array_Rep* rep, const void* elements)
{
    const auto address = reinterpret_cast<std::uintptr_t>(elements);
    const auto begin = reinterpret_cast<std::uintptr_t>(rep->data);
    return address >= begin && address < begin + bytes(rep, rep->size);
}

// Handles hold no pointer to themselves, so elements move by copying their bytes.
void relocate(__Array_Rep* to, uint32 to_pos, __Array_Rep* from, uint32 from_pos, uint32 n)
{
    if (n > 0)
        std::memmove(at(to, to_pos), at(from, from_pos), bytes(from, n));
}

} // namespace

void __construct(__Array_Rep*& rep, const __Array_Traits* traits) noexcept { rep = empty_rep(traits); }

void __construct(__Array_Rep*& rep, const __Array_Rep* from)
{
    if (from->size == 0)
        return __construct(rep, from->traits);
    rep = make_rep(from->traits, from->size);
    construct(rep, 0, from->data, from->size);
    rep->size = from->size;
}

void __destruct(__Array_Rep*& rep) noexcept
{
    destruct(rep, 0, rep->size);
    free_rep(rep);
    rep = nullptr;
}

void __assign(__Array_Rep*& rep, const __Array_Rep* from)
{
    __Array_Rep* fresh = nullptr;
    __construct(fresh, from);
    __destruct(rep);
    rep = fresh;
}

void __append(__Array_Rep*& rep, const void* elements, uint32 n) { __insert(rep, rep->size, elements, n); }
void __prepend(__Array_Rep*& rep, const void* elements, uint32 n) { __insert(rep, 0, elements, n); }

void __insert(__Array_Rep*& rep, uint32 pos, const void* elements, uint32 n)
{
    check(pos <= rep->size, "pos <= rep->size");
    if (n == 0)
        return;

    const std::size_t new_size = std::size_t{rep->size} + n;
    const uint32 tail = rep->size - pos;
    if (is_static(rep) || new_size > rep->capacity || is_own(rep, elements))
    {
        // The new elements are copied first, while elements of the array itself still stand in their place.
        __Array_Rep* grown = make_rep(rep->traits, std::max(new_size, std::size_t{is_static(rep) ? 0 : rep->capacity}));
        construct(grown, pos, elements, n);
        relocate(grown, 0, rep, 0, pos);
        relocate(grown, pos + n, rep, pos, tail);
        free_rep(std::exchange(rep, grown));
    }
    else
    {
        relocate(rep, pos + n, rep, pos, tail);
        construct(rep, pos, elements, n);
    }
    rep->size = static_cast<uint32>(new_size);
}

void __remove(__Array_Rep*& rep, uint32 pos, uint32 n)
{
    check(pos <= rep->size && n <= rep->size - pos, "pos + n <= rep->size");
    if (n == 0)
        return;
    destruct(rep, pos, n);
    relocate(rep, pos, rep, pos + n, rep->size - pos - n);
    rep->size -= n;
}

void __resize(__Array_Rep*& rep, uint32 n, const void* fill)
{
    if (n <= rep->size)
        return __remove(rep, n, rep->size - n);

    __Array_Rep* grown = n > rep->capacity || is_static(rep) ? make_rep(rep->traits, n) : rep;
    for (uint32 i = rep->size; i < n; ++i)
        construct(grown, i, fill, 1);
    if (grown != rep)
    {
        relocate(grown, 0, rep, 0, rep->size);
        free_rep(std::exchange(rep, grown));
    }
    rep->size = n;
}

void __reserve(__Array_Rep*& rep, uint32 capacity)
{
    if (capacity <= rep->capacity)
        return;
    __Array_Rep* grown = make_rep(rep->traits, capacity);
    relocate(grown, 0, rep, 0, rep->size);
    grown->size = rep->size;
    free_rep(std::exchange(rep, grown));
}

void __clear(__Array_Rep*& rep) noexcept
{
    if (rep->size == 0)
        return;
    destruct(rep, 0, rep->size);
    rep->size = 0;
}

uint32 __find(const __Array_Rep* rep, const void* element)
{
    for (uint32 i = 0; i < rep->size; ++i)
        if (equal(rep->traits, at(rep, i), element, 1))
            return i;
    return not_found;
}

bool __equal(const __Array_Rep* a, const __Array_Rep* b)
{
    return a->size == b->size && equal(a->traits, a->data, b->data, a->size);
}

} // namespace zmlr
