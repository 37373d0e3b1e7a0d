#include "runtime/string.h"

#include "runtime/ascii.h"
#include "runtime/assert.h"
#include "runtime/capacity.h"

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <initializer_list>
#include <new>
#include <string_view>

namespace zmlr
{

namespace
{

constexpr uint32 min_text_capacity = 32;

// The one representation of all empty strings. Its count of 2 marks it as shared, so that every change copies it, and is
// never changed, so that threads do not contend for it.
struct Empty_Rep
{
    __String_Rep rep;
    char terminator[4];
};
static_assert(offsetof(Empty_Rep, terminator) == sizeof(__String_Rep));

constinit Empty_Rep empty_text = {{{2}, 0, 0}, {}};

bool is_shared(const __String_Rep* rep) { return Atomic_get(&rep->refs) > 1; }

__String_Rep* acquire(__String_Rep* rep)
{
    if (rep != &empty_text.rep)
        Atomic_inc(&rep->refs);
    return rep;
}

void release(__String_Rep* rep)
{
    if (rep != &empty_text.rep && Atomic_dec_and_test(&rep->refs))
        ::operator delete(rep);
}

void set_size(__String_Rep* rep, std::size_t size)
{
    rep->size = static_cast<uint32>(size);
    rep->data()[size] = '\0';
}

std::string_view view(const __String_Rep* rep) { return {rep->data(), rep->size}; }
std::string_view view(const char* text) { return text ? std::string_view(text) : std::string_view(); }

// A new representation of at least this capacity that holds the pieces in their order.
__String_Rep* make_rep(std::size_t capacity, std::initializer_list<std::string_view> pieces)
{
    const uint32 cap = _next_pow_2(capacity, min_text_capacity);
    auto* rep = new (::operator new (sizeof(__String_Rep) + std::size_t{cap} + 1)) __String_Rep{{1}, 0, cap};

    char* end = rep->data();
    for (std::string_view piece : pieces)
        end = std::copy(piece.begin(), piece.end(), end);
    set_size(rep, static_cast<std::size_t>(end - rep->data()));
    return rep;
}

__String_Rep* join(std::initializer_list<std::string_view> pieces)
{
    std::size_t size = 0;
    for (std::string_view piece : pieces)
        size += piece.size();
    return size == 0 ? &empty_text.rep : make_rep(size, pieces);
}

void replace(__String_Rep*& rep, __String_Rep* by)
{
    release(rep);
    rep = by;
}

uint32 position(std::size_t found) { return found == std::string_view::npos ? String::npos : static_cast<uint32>(found); }

bool equal_ignoring_case(std::string_view a, std::string_view b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [](char x, char y) { return ascii::to_lower(x) == ascii::to_lower(y); });
}

} // namespace

String::String() noexcept : _rep(&empty_text.rep) {}
String::String(const String& x) noexcept : _rep(acquire(x._rep)) {}
String::String(String&& x) noexcept : _rep(std::exchange(x._rep, &empty_text.rep)) {}
String::String(const char* text) : _rep(join({view(text)})) {}
String::String(const char* text, std::size_t size) : _rep(join({{text, size}})) {}
String::String(const char* s1, std::size_t n1, const char* s2, std::size_t n2) : _rep(join({{s1, n1}, {s2, n2}})) {}
String::String(const char* s1, std::size_t n1, const char* s2, std::size_t n2, const char* s3, std::size_t n3)
    : _rep(join({{s1, n1}, {s2, n2}, {s3, n3}}))
{
}
String::~String() { release(_rep); }

String& String::operator=(const String& x) noexcept
{
    assign(x);
    return *this;
}

String& String::operator=(String&& x) noexcept
{
    std::swap(_rep, x._rep);
    return *this;
}

String& String::operator=(const char* text)
{
    assign(text);
    return *this;
}

void String::assign(const String& x) noexcept { replace(_rep, acquire(x._rep)); }

void String::assign(const char* text)
{
    const std::string_view all = view(text);
    assign(all.data(), all.size());
}

void String::assign(const char* text, std::size_t size)
{
    if (is_shared(_rep) || _rep->cap < size)
        return replace(_rep, join({{text, size}}));
    if (size > 0)
        std::memmove(_rep->data(), text, size);
    set_size(_rep, size);
}

void String::append(char c)
{
    if (is_shared(_rep) || _rep->size == _rep->cap)
        replace(_rep, make_rep(std::size_t{_rep->cap} * 2, {view(_rep)}));
    _rep->data()[_rep->size] = c;
    set_size(_rep, _rep->size + 1);
}

void String::append(const char* text)
{
    const std::string_view all = view(text);
    append(all.data(), all.size());
}

void String::append(const char* text, std::size_t size)
{
    if (size == 0)
        return;

    const std::size_t new_size = _rep->size + size;
    if (is_shared(_rep) || _rep->cap < _next_pow_2(new_size, min_text_capacity))
        return replace(_rep, make_rep(new_size, {view(_rep), {text, size}}));
    std::memmove(_rep->data() + _rep->size, text, size);
    set_size(_rep, new_size);
}

void String::append(const String& x) { append(x.c_str(), x.size()); }

void String::remove(uint32 pos, uint32 n)
{
    const uint32 size = _rep->size;
    check(pos <= size && (n == npos || n <= size - pos), "pos + n <= _rep->size");
    if (n == npos)
        n = size - pos;
    if (n == 0)
        return;

    const std::string_view tail = view(_rep).substr(pos + n);
    if (is_shared(_rep))
        return replace(_rep, join({view(_rep).substr(0, pos), tail}));
    std::memmove(_rep->data() + pos, tail.data(), tail.size());
    set_size(_rep, size - n);
}

String String::substr(uint32 pos, uint32 n) const
{
    check(pos <= size() && (n == npos || n <= size() - pos), "pos + n <= _rep->size");
    return String(c_str() + pos, n == npos ? size() - pos : n);
}

void String::clear()
{
    if (is_shared(_rep))
        replace(_rep, &empty_text.rep);
    else
        set_size(_rep, 0);
}

void String::set(uint32 i, char c)
{
    check(i <= _rep->size, "i <= _rep->size");
    if (i == _rep->size)
        return append(c);
    if (is_shared(_rep))
        replace(_rep, make_rep(_rep->size, {view(_rep)}));
    _rep->data()[i] = c;
}

void String::reserve(uint32 capacity)
{
    const uint32 wanted = std::max(capacity, _rep->size);
    if (wanted > 0 && (is_shared(_rep) || _rep->cap < wanted))
        replace(_rep, make_rep(wanted, {view(_rep)}));
}

char String::operator[](uint32 i) const
{
    check(i <= _rep->size, "i <= _rep->size");
    return c_str()[i];
}

uint32 String::find(char c) const { return position(view(_rep).find(c)); }

uint32 String::find(uint32 pos, char c) const
{
    check(pos <= _rep->size, "i <= _rep->size");
    return position(view(_rep).find(c, pos));
}

uint32 String::find(const char* text) const { return position(view(_rep).find(view(text))); }
uint32 String::find(const String& x) const { return position(view(_rep).find(view(x._rep))); }

bool String::equal(const String& x) const { return _rep == x._rep || view(_rep) == view(x._rep); }
bool String::equal(const char* text) const { return view(_rep) == view(text); }
bool String::equal(const char* text, std::size_t size) const { return view(_rep) == std::string_view(text, size); }

bool String::equal(uint32 pos, uint32 n, const char* text) const
{
    check(n <= size(), "n <= _rep->size");
    check(pos <= size() - n, "pos + n <= _rep->size");
    return view(_rep).substr(pos, n) == view(text);
}

bool String::equali(const String& x) const { return equal_ignoring_case(view(_rep), view(x._rep)); }
bool String::equali(const char* text) const { return equal_ignoring_case(view(_rep), view(text)); }

String operator+(const String& a, const String& b) { return String(a.c_str(), a.size(), b.c_str(), b.size()); }

String operator+(const String& a, const char* b)
{
    const std::string_view text = view(b);
    return String(a.c_str(), a.size(), text.data(), text.size());
}

String operator+(const char* a, const String& b)
{
    const std::string_view text = view(a);
    return String(text.data(), text.size(), b.c_str(), b.size());
}

} // namespace zmlr
