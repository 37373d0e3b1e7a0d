// Buffer: a growable run of bytes, in which the log puts its lines together.
#pragma once

#include "runtime/types.h"

#include <cstdarg>
#include <cstddef>

namespace zmlr
{

// One byte more than the capacity is always allocated, for the zero that data() writes. Capacities are powers of two, at
// least 4096. Texts given are not the buffer's own. A position past the end is an internal-consistency failure. When memory runs
// out (std::bad_alloc) the buffer keeps what it had.
class Buffer
{
public:
    Buffer() = default;
    ~Buffer();
    Buffer(const Buffer&) = delete;
    Buffer& operator=(const Buffer&) = delete;

    void append(char c);
    void append(const char* text, std::size_t n);
    void append_uint16(uint16 x) { append_uint64(x); }
    void append_uint32(uint32 x) { append_uint64(x); }
    void append_uint64(uint64 x); // decimal digits
    void insert(std::size_t pos, const char* text, std::size_t n);
    void remove(std::size_t pos, std::size_t n);
    void reserve(std::size_t n);

    // Appends formatted text.
    [[gnu::format(printf, 2, 3)]] void format(const char* format, ...);
    [[gnu::format(printf, 2, 0)]] void vformat(const char* format, va_list arguments);

    std::size_t size() const { return _size; }
    std::size_t capacity() const { return _cap; }
    char operator[](std::size_t i) const; // at size(): zero
    const char* data();                   // the contents and a terminating zero, until the next change

private:
    char* _data = nullptr;
    std::size_t _size = 0;
    std::size_t _cap = 0;
};

} // namespace zmlr
