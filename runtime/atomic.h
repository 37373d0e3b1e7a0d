// A 32-bit counter whose changes are full barriers: the reference count of everything that threads share.
#pragma once

#include <cstdint>

namespace zmlr
{

struct Atomic
{
    std::uint32_t n;
};

inline void Atomic_create(Atomic* atomic, std::uint32_t value) { __atomic_store_n(&atomic->n, value, __ATOMIC_SEQ_CST); }
inline void Atomic_destroy(Atomic*) {}
inline std::uint32_t Atomic_get(const Atomic* atomic) { return __atomic_load_n(&atomic->n, __ATOMIC_SEQ_CST); }
inline void Atomic_inc(Atomic* atomic) { __atomic_add_fetch(&atomic->n, 1, __ATOMIC_SEQ_CST); }

// True when the count has reached 0.
inline bool Atomic_dec_and_test(Atomic* atomic) { return __atomic_sub_fetch(&atomic->n, 1, __ATOMIC_SEQ_CST) == 0; }

} // namespace zmlr
