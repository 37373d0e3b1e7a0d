// String: a copy-on-write text of CIM (one handle of pointer size), and bounded helpers on plain text.
#pragma once

#include "runtime/atomic.h"
#include "runtime/types.h"

#include <cstddef>
#include <utility>

namespace zmlr
{

// The shared representation: `size` characters at `data`, which has room for `cap` and a terminating zero.
struct __String_Rep
{
    Atomic refs;
    uint32 size;
    uint32 cap;
    char* data() { return reinterpret_cast<char*>(this + 1); }
    const char* data() const { return reinterpret_cast<const char*>(this + 1); }
};

// A text that the program knows, of at most `room` characters. Strings of it take no memory: they share it, and whoever changes
// one has a copy. It must outlive them.
template <std::size_t room> struct Fixed_Text
{
    consteval Fixed_Text(const char* from) : rep{{1}, 0, room}
    {
        for (; from[rep.size] != '\0'; rep.size++)
            text[rep.size] = from[rep.size];
        if (rep.size > room) // no constant: it does not compile
            throw from;
    }

    __String_Rep rep; // counts one more than there are strings
    char text[room + 1] = {};
};
static_assert(offsetof(Fixed_Text<1>, text) == sizeof(__String_Rep));

// Copies share one representation (reference counted, safe across threads); a change to a shared one copies it first.
// A single handle must not be changed by two threads at once. Not-found results are String::npos. Texts given to an
// operation may be the string's own; a null text counts as empty. A position past the end is an internal-consistency
// failure. More than 2^31 characters are std::bad_array_new_length; when memory runs out the string keeps what it had.
//
// Capacities are powers of two, at least 32; the empty string has none and needs no memory.
class String
{
public:
    static constexpr uint32 npos = 0xFFFFFFFF;

    String() noexcept;
    String(const String& x) noexcept;
    String(String&& x) noexcept;
    String(const char* text);
    String(const char* text, std::size_t size);
    template <std::size_t room> String(Fixed_Text<room>& text) noexcept : _rep(&text.rep) { Atomic_inc(&_rep->refs); }
    String(const char* s1, std::size_t n1, const char* s2, std::size_t n2);
    String(const char* s1, std::size_t n1, const char* s2, std::size_t n2, const char* s3, std::size_t n3);
    ~String();

    String& operator=(const String& x) noexcept;
    String& operator=(String&& x) noexcept;
    String& operator=(const char* text);

    void assign(const String& x) noexcept;
    void assign(const char* text);
    void assign(const char* text, std::size_t size);
    void append(char c);
    void append(const char* text);
    void append(const char* text, std::size_t size);
    void append(const String& x);
    void remove(uint32 pos, uint32 n = npos);
    String substr(uint32 pos, uint32 n = npos) const;
    void clear();
    void set(uint32 i, char c); // at i == size(): appends c
    void reserve(uint32 capacity);

    uint32 size() const { return _rep->size; }
    uint32 capacity() const { return _rep->cap; }
    bool empty() const { return _rep->size == 0; }
    const char* c_str() const { return std::as_const(*_rep).data(); }
    char operator[](uint32 i) const; // at size(): the terminating zero

    uint32 find(char c) const;
    uint32 find(uint32 pos, char c) const;
    uint32 find(const char* text) const;
    uint32 find(const String& x) const;

    bool equal(const String& x) const;
    bool equal(const char* text) const;
    bool equal(const char* text, std::size_t size) const;
    bool equal(uint32 pos, uint32 n, const char* text) const; // the n characters from pos against the whole text
    bool equali(const String& x) const;                       // ASCII letters compared without regard to case
    bool equali(const char* text) const;

private:
    __String_Rep* _rep;
};

inline bool operator==(const String& a, const String& b) { return a.equal(b); }
inline bool operator==(const String& a, const char* b) { return a.equal(b); }
String operator+(const String& a, const String& b);
String operator+(const String& a, const char* b);
String operator+(const char* a, const String& b);

// True when both texts are equal without regard to the case of ASCII letters. How every CIM name is compared.
bool eqi(const char* a, const char* b);

// Bounded copy and append; dst is terminated whenever size > 0. Both return the length they tried to make
// (strlcat returns size when dst holds no terminator within size).
std::size_t strlcpy(char* dst, const char* src, std::size_t size);
std::size_t strlcat(char* dst, const char* src, std::size_t size);

// Finds the first token of the text: what follows leading separators up to the next separator or the end. 0 with the token's
// first character and the one behind its last, or -1 (and nothing written) when there are separators only.
int find_token(const char* text, const char* separators, const char*& start, const char*& end);

} // namespace zmlr
