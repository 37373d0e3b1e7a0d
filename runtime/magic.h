// A validity mark: holds N while its owner lives and 0xDDDDDDDD after the owner's destruction.
#pragma once

#include <cstdint>

namespace zmlr
{

inline constexpr std::uint32_t DESTROYED_MAGIC = 0xDDDDDDDD;

template <std::uint32_t N> class Magic
{
public:
    Magic() = default;
    Magic(const Magic&) {}
    Magic& operator=(const Magic&) { return *this; }

    // The store is volatile: it must reach memory although the object ends here.
    ~Magic() { *static_cast<volatile std::uint32_t*>(&_magic) = DESTROYED_MAGIC; }

    explicit operator bool() const { return _magic == N; }

private:
    std::uint32_t _magic = N;
};

} // namespace zmlr
