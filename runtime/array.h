// Array<T>: a growable sequence held by value (one handle of pointer size; copies copy every element).
//
// An empty array takes no memory of its own until something is put into it. Elements given to an operation may be the
// array's own. Where something is inserted or removed a position past the end is an internal-consistency failure; [] does not
// look. More than 2^31 elements are std::bad_array_new_length. When memory runs out the array keeps what it had.
#pragma once

#include "runtime/datetime.h"
#include "runtime/string.h"
#include "runtime/types.h"

#include <cstddef>
#include <initializer_list>
#include <utility>

namespace zmlr
{

// How the elements of one type are made, destroyed and compared. A null function means: plain memory.
struct __Array_Traits
{
    uint32 elem_size;
    void (*construct)(void* data, const void* from, uint32 n); // from null: n default elements
    void (*destruct)(void* data, uint32 n);
    bool (*equal)(const void* a, const void* b, uint32 n);
};

extern const __Array_Traits __cim_array_traits[num_types]; // indexed by Type
extern const __Array_Traits __pointer_array_traits;        // Array<Instance*>

struct __Array_Rep
{
    const __Array_Traits* traits;
    uint32 size;
    uint32 capacity;
    Atomic refs; // arrays never share: not used
    alignas(8) unsigned char data[1];
};

// Untyped operations: generic code works through meta-data on handles of any element type.
void __construct(__Array_Rep*& rep, const __Array_Traits* traits) noexcept;
void __construct(__Array_Rep*& rep, const __Array_Rep* from);
void __destruct(__Array_Rep*& rep) noexcept;
void __assign(__Array_Rep*& rep, const __Array_Rep* from);
void __append(__Array_Rep*& rep, const void* elements, uint32 n);
void __prepend(__Array_Rep*& rep, const void* elements, uint32 n);
void __insert(__Array_Rep*& rep, uint32 pos, const void* elements, uint32 n);
void __remove(__Array_Rep*& rep, uint32 pos, uint32 n);
void __resize(__Array_Rep*& rep, uint32 n, const void* fill); // from null: default elements
void __reserve(__Array_Rep*& rep, uint32 capacity);
void __clear(__Array_Rep*& rep) noexcept;
uint32 __find(const __Array_Rep* rep, const void* element); // index, or 0xFFFFFFFF
bool __equal(const __Array_Rep* a, const __Array_Rep* b);

// The Type code of a CIM scalar.
// clang-format off
template <class T> struct type_code;
template <> struct type_code<boolean>  { static constexpr Type value = BOOLEAN; };
template <> struct type_code<uint8>    { static constexpr Type value = UINT8; };
template <> struct type_code<sint8>    { static constexpr Type value = SINT8; };
template <> struct type_code<uint16>   { static constexpr Type value = UINT16; };
template <> struct type_code<sint16>   { static constexpr Type value = SINT16; };
template <> struct type_code<uint32>   { static constexpr Type value = UINT32; };
template <> struct type_code<sint32>   { static constexpr Type value = SINT32; };
template <> struct type_code<uint64>   { static constexpr Type value = UINT64; };
template <> struct type_code<sint64>   { static constexpr Type value = SINT64; };
template <> struct type_code<real32>   { static constexpr Type value = REAL32; };
template <> struct type_code<real64>   { static constexpr Type value = REAL64; };
template <> struct type_code<char16>   { static constexpr Type value = CHAR16; };
template <> struct type_code<String>   { static constexpr Type value = STRING; };
template <> struct type_code<Datetime> { static constexpr Type value = DATETIME; };
// clang-format on

template <class T> struct array_traits
{
    static const __Array_Traits* get() { return &__cim_array_traits[type_code<T>::value]; }
};

template <class T> struct array_traits<T*>
{
    static const __Array_Traits* get() { return &__pointer_array_traits; }
};

template <class T> class Array
{
public:
    Array() noexcept { __construct(_rep, array_traits<T>::get()); }
    Array(const Array& x) { __construct(_rep, x._rep); }
    Array(Array&& x) noexcept : Array() { std::swap(_rep, x._rep); }
    Array(std::initializer_list<T> elements) : Array() { __append(_rep, elements.begin(), static_cast<uint32>(elements.size())); }
    ~Array() { __destruct(_rep); }

    Array& operator=(const Array& x)
    {
        if (this != &x)
            __assign(_rep, x._rep);
        return *this;
    }

    Array& operator=(Array&& x) noexcept
    {
        std::swap(_rep, x._rep);
        return *this;
    }

    uint32 size() const { return _rep->size; }
    uint32 capacity() const { return _rep->capacity; }
    bool empty() const { return _rep->size == 0; }
    T* data() { return reinterpret_cast<T*>(_rep->data); }
    const T* data() const { return reinterpret_cast<const T*>(_rep->data); }
    T& operator[](uint32 i) { return data()[i]; }
    const T& operator[](uint32 i) const { return data()[i]; }
    T* begin() { return data(); }
    T* end() { return data() + size(); }
    const T* begin() const { return data(); }
    const T* end() const { return data() + size(); }

    void append(const T& x) { __append(_rep, &x, 1); }
    void append(const T* x, uint32 n) { __append(_rep, x, n); }
    void prepend(const T& x) { __prepend(_rep, &x, 1); }
    void prepend(const T* x, uint32 n) { __prepend(_rep, x, n); }
    void insert(uint32 pos, const T* x, uint32 n) { __insert(_rep, pos, x, n); }
    void remove(uint32 pos, uint32 n = 1) { __remove(_rep, pos, n); }
    void resize(uint32 n, const T& fill) { __resize(_rep, n, &fill); }
    void reserve(uint32 capacity) { __reserve(_rep, capacity); }
    void clear() { __clear(_rep); }
    uint32 find(const T& x) const { return __find(_rep, &x); }
    friend bool operator==(const Array& a, const Array& b) { return __equal(a._rep, b._rep); }

private:
    __Array_Rep* _rep;
};

} // namespace zmlr
