#include "cimserver/model/cim_types.h"

#include "runtime/types.h"

#include <algorithm>
#include <iterator>

namespace cimserver
{
namespace
{

// The first rows in the order of zmlr::Type.
// clang-format off
constexpr Cim_Type types[] = {
    {CMPI_boolean,  "boolean",   0,  false},
    {CMPI_uint8,    "uint8",     8,  false},
    {CMPI_sint8,    "sint8",     8,  true},
    {CMPI_uint16,   "uint16",    16, false},
    {CMPI_sint16,   "sint16",    16, true},
    {CMPI_uint32,   "uint32",    32, false},
    {CMPI_sint32,   "sint32",    32, true},
    {CMPI_uint64,   "uint64",    64, false},
    {CMPI_sint64,   "sint64",    64, true},
    {CMPI_real32,   "real32",    0,  false},
    {CMPI_real64,   "real64",    0,  false},
    {CMPI_char16,   "char16",    16, false},
    {CMPI_string,   "string",    0,  false},
    {CMPI_dateTime, "datetime",  0,  false},
    {CMPI_ref,      "reference", 0,  false},
    {CMPI_instance, "string",    0,  false},
};
// clang-format on
static_assert(types[zmlr::DATETIME].code == CMPI_dateTime && types[zmlr::CHAR16].code == CMPI_char16);

} // namespace

const Cim_Type* find_type(CMPIType type)
{
    const auto* row = std::ranges::find(types, element_of(type), &Cim_Type::code);
    return row == std::end(types) ? nullptr : row;
}

const char* cim_type_name(CMPIType type)
{
    const Cim_Type* found = find_type(type);
    return found ? found->name : nullptr;
}

CMPIType cmpi_type(unsigned type) { return type < zmlr::num_types ? types[type].code : static_cast<CMPIType>(CMPI_null); }

} // namespace cimserver
