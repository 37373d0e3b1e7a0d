// The CIM scalar types, their codes and their sizes in an instance.
#pragma once

#include <cstdint>

namespace zmlr
{

using boolean = bool;
using uint8 = std::uint8_t;
using sint8 = std::int8_t;
using uint16 = std::uint16_t;
using sint16 = std::int16_t;
using uint32 = std::uint32_t;
using sint32 = std::int32_t;
using uint64 = std::uint64_t;
using sint64 = std::int64_t;
using real32 = float;
using real64 = double;

// One UTF-16 code unit (CIM char16).
class char16
{
public:
    constexpr char16() = default;
    constexpr explicit char16(uint16 code) : _code(code) {}
    constexpr uint16 code() const { return _code; }
    friend constexpr bool operator==(char16, char16) = default;

private:
    uint16 _code = 0;
};

enum Type : uint32
{
    BOOLEAN = 0,
    UINT8 = 1,
    SINT8 = 2,
    UINT16 = 3,
    SINT16 = 4,
    UINT32 = 5,
    SINT32 = 6,
    UINT64 = 7,
    SINT64 = 8,
    REAL32 = 9,
    REAL64 = 10,
    CHAR16 = 11,
    STRING = 12,
    DATETIME = 13
};

inline constexpr uint32 num_types = 14;

// Lower-case CIM names ("boolean" ... "datetime"), indexed by Type.
extern const char* const type_name[num_types];

// The type of a name, compared without regard to case: 0, or -1 (and nothing written) for an unknown or empty name.
int type_name_to_type(const char* name, Type& type);

// Bytes of a value of each type in an instance, indexed by Type. A String and a Datetime are one handle of pointer size.
extern const uint8 type_size[num_types];

} // namespace zmlr
