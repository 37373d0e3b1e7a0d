#include "runtime/buffer.h"

#include "runtime/assert.h"
#include "runtime/capacity.h"
#include "runtime/number.h"

#include <cstdio>
#include <cstring>
#include <new>
#include <utility>

namespace zmlr
{

namespace
{

constexpr uint32 min_buffer_capacity = 4096;

} // namespace

Buffer::~Buffer() { ::operator delete(_data); }

void Buffer::reserve(std::size_t n)
{
    if (_data && n <= _cap)
        return;
    const std::size_t cap = _next_pow_2(n, min_buffer_capacity);
    auto* grown = static_cast<char*>(::operator new(cap + 1));
    if (_size > 0)
        std::memcpy(grown, _data, _size);
    ::operator delete(std::exchange(_data, grown));
    _cap = cap;
}

void Buffer::append(char c)
{
    reserve(_size + 1);
    _data[_size++] = c;
}

void Buffer::append(const char* text, std::size_t n) { insert(_size, text, n); }

void Buffer::append_uint64(uint64 x)
{
    char buffer[number_text_size];
    uint32 size = 0;
    const char* digits = uint64_to_str(buffer, x, size);
    append(digits, size);
}

void Buffer::insert(std::size_t pos, const char* text, std::size_t n)
{
    check(pos <= _size, "i <= _size");
    if (n == 0)
        return;
    reserve(_size + n);
    std::memmove(_data + pos + n, _data + pos, _size - pos);
    std::memcpy(_data + pos, text, n);
    _size += n;
}

void Buffer::remove(std::size_t pos, std::size_t n)
{
    check(pos <= _size && n <= _size - pos, "i + size <= _size");
    if (n == 0)
        return;
    std::memmove(_data + pos, _data + pos + n, _size - pos - n);
    _size -= n;
}

void Buffer::format(const char* format, ...)
{
    va_list arguments;
    va_start(arguments, format);
    vformat(format, arguments); // va_end releases nothing on the platforms we run on: an exception may pass it by
    va_end(arguments);
}

void Buffer::vformat(const char* format, va_list arguments)
{
    reserve(_size + 1);
    va_list again;
    va_copy(again, arguments);
    const int length = std::vsnprintf(_data + _size, _cap + 1 - _size, format, again);
    va_end(again);

    const auto wanted = static_cast<std::size_t>(length < 0 ? 0 : length);
    if (wanted > _cap - _size)
    {
        reserve(_size + wanted);
        std::vsnprintf(_data + _size, _cap + 1 - _size, format, arguments);
    }
    _size += wanted;
}

char Buffer::operator[](std::size_t i) const
{
    check(i <= _size, "i <= _size");
    return i < _size ? _data[i] : '\0';
}

const char* Buffer::data()
{
    if (!_data)
        return "";
    _data[_size] = '\0';
    return _data;
}

} // namespace zmlr
