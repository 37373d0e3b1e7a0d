#include "runtime/array.h"

#include <algorithm>
#include <memory>
#include <new>

namespace zmlr
{

namespace
{

template <class T> void construct(void* data, const void* from, uint32 n)
{
    auto* elements = static_cast<T*>(data);
    if (from)
        std::uninitialized_copy_n(static_cast<const T*>(from), n, elements);
    else
        std::uninitialized_value_construct_n(elements, n);
}

template <class T> void destruct(void* data, uint32 n) { std::destroy_n(static_cast<T*>(data), n); }

template <class T> bool equal(const void* a, const void* b, uint32 n)
{
    const auto* elements = static_cast<const T*>(a);
    return std::equal(elements, elements + n, static_cast<const T*>(b));
}

template <class T> constexpr __Array_Traits plain = {sizeof(T), nullptr, nullptr, nullptr};
template <class T> constexpr __Array_Traits real = {sizeof(T), nullptr, nullptr, equal<T>}; // NaN differs from itself
template <class T> constexpr __Array_Traits handle = {sizeof(T), construct<T>, destruct<T>, equal<T>};

} // namespace

constinit const __Array_Traits __cim_array_traits[num_types] = {
    plain<boolean>, plain<uint8>,  plain<sint8>, plain<uint16>, plain<sint16>, plain<uint32>,  plain<sint32>,
    plain<uint64>,  plain<sint64>, real<real32>, real<real64>,  plain<char16>, handle<String>, handle<Datetime>,
};

constinit const __Array_Traits __pointer_array_traits = plain<void*>;

} // namespace zmlr
