#include "cimserver/broker/cmpi_values.h"

namespace cimserver
{
namespace
{

// The content of an object argument, or a null value when there is no object.
template <class T, class Convert> Value from_object(CMPIType type, const typename T::Face* face, Convert convert)
{
    if (!face)
        return {type, {}};
    return {type, convert(object<T>(face))};
}

// A signed number has the same bits.
void put_integer(CMPIValue& value, std::uint64_t number, unsigned bits)
{
    if (bits == 8)
        value.uint8 = static_cast<CMPIUint8>(number);
    else if (bits == 16)
        value.uint16 = static_cast<CMPIUint16>(number);
    else if (bits == 32)
        value.uint32 = static_cast<CMPIUint32>(number);
    else
        value.uint64 = number;
}

Value from_scalar(const CMPIValue& value, CMPIType type)
{
    switch (type)
    {
    case CMPI_boolean:
        return {type, value.boolean != 0};
    case CMPI_uint8:
        return {type, std::uint64_t{value.uint8}};
    case CMPI_uint16:
    case CMPI_char16:
        return {type, std::uint64_t{value.uint16}};
    case CMPI_uint32:
        return {type, std::uint64_t{value.uint32}};
    case CMPI_uint64:
        return {type, std::uint64_t{value.uint64}};
    case CMPI_sint8:
        return {type, std::int64_t{value.sint8}};
    case CMPI_sint16:
        return {type, std::int64_t{value.sint16}};
    case CMPI_sint32:
        return {type, std::int64_t{value.sint32}};
    case CMPI_sint64:
        return {type, std::int64_t{value.sint64}};
    case CMPI_real32:
        return {type, double{value.real32}};
    case CMPI_real64:
        return {type, value.real64};
    case CMPI_string:
        return from_object<String_Object>(type, value.string, [](const String_Object& string) { return string.text; });
    case CMPI_dateTime:
        return from_object<Datetime_Object>(type, value.dateTime, [](const Datetime_Object& datetime) { return datetime.text; });
    case CMPI_ref:
        return from_object<Path_Object>(type, value.ref, [](const Path_Object& path) { return path.path; });
    case CMPI_instance:
        return from_object<Instance_Object>(type, value.inst, [](const Instance_Object& instance) { return instance.model(); });
    default:
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
}

// The declared element type stands in the request, the real one in the array: they must agree.
Value from_array(const CMPIArray* face, CMPIType type)
{
    if (!face)
        return {type, {}};
    const auto& array = object<Array_Object>(face);
    if (array_of(array.element_type) != type)
        throw Failure{CMPI_RC_ERR_TYPE_MISMATCH};
    return {type, array.elements};
}

// The objects among the values.
CMPIValue to_pointer(const Value& value)
{
    switch (value.type)
    {
    case CMPI_string:
        return {.string = make<String_Object>(std::get<Text>(value.content)).face()};
    case CMPI_dateTime:
        return {.dateTime = make<Datetime_Object>(std::get<Text>(value.content)).face()};
    case CMPI_ref:
        return {.ref = make<Path_Object>(value.get<Object_Path>()).face()};
    case CMPI_instance:
        return {.inst = make<Instance_Object>(value.get<Instance>()).face()};
    default:
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
}

CMPIValue to_scalar(const Value& value)
{
    const Cim_Type* type = find_type(value.type);
    CMPIValue result{.uint64 = 0};
    if (type && type->is_signed)
        put_integer(result, static_cast<std::uint64_t>(value.get<std::int64_t>()), type->bits);
    else if (type && type->bits > 0)
        put_integer(result, value.get<std::uint64_t>(), type->bits);
    else if (value.type == CMPI_boolean)
        result.boolean = value.get<bool>();
    else if (value.type == CMPI_real32)
        result.real32 = static_cast<CMPIReal32>(value.get<double>());
    else if (value.type == CMPI_real64)
        result.real64 = value.get<double>();
    else
        return to_pointer(value);
    return result;
}

} // namespace

bool is_scalar(CMPIType type) { return (type & CMPI_ARRAY) == 0 && find_type(type); }

Value from_cmpi(const CMPIValue* value, CMPIType type)
{
    if (type == CMPI_null)
        return {};
    if (type == CMPI_chars)
        return {CMPI_string, value ? Value::Content(Text(reinterpret_cast<const char*>(value))) : Value::Content()};
    if (type == array_of(CMPI_chars))
        type = array_of(CMPI_string);
    if (value && (type & CMPI_ARRAY) == 0)
        return from_scalar(*value, type);
    if (!find_type(type))
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    return value ? from_array(value->array, type) : Value{type, {}};
}

CMPIData to_cmpi(const Value& value)
{
    CMPIData data{value.type, CMPI_goodValue, {.uint64 = 0}};
    if (value.null())
        data.state = CMPI_nullValue;
    else if ((value.type & CMPI_ARRAY) != 0)
        data.value.array = make<Array_Object>(element_of(value.type), value.get<std::vector<Value>>()).face();
    else
        data.value = to_scalar(value);
    return data;
}

CMPIData data_named(const std::vector<Named_Value>& list, const char* name)
{
    const Named_Value* found = find_named(list, required(name));
    if (!found)
        throw Failure{CMPI_RC_ERR_NOT_FOUND};
    return to_cmpi(found->value);
}

CMPIData data_at(const std::vector<Named_Value>& list, CMPICount index, CMPIString** name)
{
    if (index >= list.size())
        throw Failure{CMPI_RC_ERR_NOT_FOUND};
    if (name)
        *name = make<String_Object>(list[index].name).face();
    return to_cmpi(list[index].value);
}

} // namespace cimserver
