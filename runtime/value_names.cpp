#include "runtime/value.h"

namespace zmlr
{

namespace
{

struct Type_Names
{
    Value::Type type;
    const char* lower;
    const char* upper;
};

// clang-format off
constexpr Type_Names names[] = {
    {Value::BOOLEAN,        "boolean",        "BOOLEAN"},
    {Value::UINT8,          "uint8",          "UINT8"},
    {Value::SINT8,          "sint8",          "SINT8"},
    {Value::UINT16,         "uint16",         "UINT16"},
    {Value::SINT16,         "sint16",         "SINT16"},
    {Value::UINT32,         "uint32",         "UINT32"},
    {Value::SINT32,         "sint32",         "SINT32"},
    {Value::UINT64,         "uint64",         "UINT64"},
    {Value::SINT64,         "sint64",         "SINT64"},
    {Value::REAL32,         "real32",         "REAL32"},
    {Value::REAL64,         "real64",         "REAL64"},
    {Value::CHAR16,         "char16",         "CHAR16"},
    {Value::STRING,         "string",         "STRING"},
    {Value::DATETIME,       "datetime",       "DATETIME"},
    {Value::INSTANCE,       "instance",       "INSTANCE"},
    {Value::BOOLEAN_ARRAY,  "boolean_array",  "BOOLEAN_ARRAY"},
    {Value::UINT8_ARRAY,    "uint8_array",    "UINT8_ARRAY"},
    {Value::SINT8_ARRAY,    "sint8_array",    "SINT8_ARRAY"},
    {Value::UINT16_ARRAY,   "uint16_array",   "UINT16_ARRAY"},
    {Value::SINT16_ARRAY,   "sint16_array",   "SINT16_ARRAY"},
    {Value::UINT32_ARRAY,   "uint32_array",   "UINT32_ARRAY"},
    {Value::SINT32_ARRAY,   "sint32_array",   "SINT32_ARRAY"},
    {Value::UINT64_ARRAY,   "uint64_array",   "UINT64_ARRAY"},
    {Value::SINT64_ARRAY,   "sint64_array",   "SINT64_ARRAY"},
    {Value::REAL32_ARRAY,   "real32_array",   "REAL32_ARRAY"},
    {Value::REAL64_ARRAY,   "real64_array",   "REAL64_ARRAY"},
    {Value::CHAR16_ARRAY,   "char16_array",   "CHAR16_ARRAY"},
    {Value::STRING_ARRAY,   "string_array",   "STRING_ARRAY"},
    {Value::DATETIME_ARRAY, "datetime_array", "DATETIME_ARRAY"},
    {Value::INSTANCE_ARRAY, "instance_array", "INSTANCE_ARRAY"},
};
// clang-format on

const Type_Names* find(Value::Type type)
{
    for (const Type_Names& entry : names)
        if (entry.type == type)
            return &entry;
    return nullptr;
}

} // namespace

const char* name_of(Value::Type type)
{
    const Type_Names* entry = find(type);
    return entry ? entry->lower : "none";
}

const char* _type_name(Value::Type type)
{
    const Type_Names* entry = find(type);
    return entry ? entry->upper : "NONE";
}

} // namespace zmlr
