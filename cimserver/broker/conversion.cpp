#include "cimserver/broker/conversion.h"

#include <algorithm>
#include <iterator>

namespace cimserver
{
namespace
{

constexpr CMPIType array_of(CMPIType type) { return static_cast<CMPIType>(type | CMPI_ARRAY); }
constexpr CMPIType element_of(CMPIType type) { return static_cast<CMPIType>(type & ~CMPI_ARRAY); }

Value unsigned_value(CMPIType type, std::uint64_t number) { return {type, number}; }
Value signed_value(CMPIType type, std::int64_t number) { return {type, number}; }

// The content of an object argument, or a null value when there is no object.
template <class T, class Convert> Value from_object(CMPIType type, const typename T::Face* face, Convert convert)
{
    if (!face)
        return {type, {}};
    return {type, convert(object<T>(face))};
}

Value from_pointer(const CMPIValue& value, CMPIType type)
{
    switch (type)
    {
    case CMPI_string:
        return from_object<String_Object>(type, value.string, [](const String_Object& string) { return string.text; });
    case CMPI_dateTime:
        return from_object<Datetime_Object>(type, value.dateTime, [](const Datetime_Object& datetime) { return datetime.text; });
    case CMPI_ref:
        return from_object<Path_Object>(type, value.ref,
                                        [](const Path_Object& path) { return std::make_shared<const Object_Path>(path.path); });
    case CMPI_instance:
        return from_object<Instance_Object>(
            type, value.inst, [](const Instance_Object& instance) { return std::make_shared<const Instance>(instance.model()); });
    default:
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
}

Value from_scalar(const CMPIValue& value, CMPIType type)
{
    switch (type)
    {
    case CMPI_boolean:
        return {type, value.boolean != 0};
    case CMPI_char16:
        return unsigned_value(type, value.char16);
    case CMPI_uint8:
        return unsigned_value(type, value.uint8);
    case CMPI_uint16:
        return unsigned_value(type, value.uint16);
    case CMPI_uint32:
        return unsigned_value(type, value.uint32);
    case CMPI_uint64:
        return unsigned_value(type, value.uint64);
    case CMPI_sint8:
        return signed_value(type, value.sint8);
    case CMPI_sint16:
        return signed_value(type, value.sint16);
    case CMPI_sint32:
        return signed_value(type, value.sint32);
    case CMPI_sint64:
        return signed_value(type, value.sint64);
    case CMPI_real32:
        return {type, static_cast<double>(value.real32)};
    case CMPI_real64:
        return {type, value.real64};
    default:
        return from_pointer(value, type);
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

CMPIValue to_scalar(const Value& value)
{
    CMPIValue result{.uint64 = 0};
    switch (value.type)
    {
    case CMPI_boolean:
        result.boolean = std::get<bool>(value.content);
        break;
    case CMPI_char16:
        result.char16 = static_cast<CMPIChar16>(std::get<std::uint64_t>(value.content));
        break;
    case CMPI_uint8:
        result.uint8 = static_cast<CMPIUint8>(std::get<std::uint64_t>(value.content));
        break;
    case CMPI_uint16:
        result.uint16 = static_cast<CMPIUint16>(std::get<std::uint64_t>(value.content));
        break;
    case CMPI_uint32:
        result.uint32 = static_cast<CMPIUint32>(std::get<std::uint64_t>(value.content));
        break;
    case CMPI_uint64:
        result.uint64 = std::get<std::uint64_t>(value.content);
        break;
    case CMPI_sint8:
        result.sint8 = static_cast<CMPISint8>(std::get<std::int64_t>(value.content));
        break;
    case CMPI_sint16:
        result.sint16 = static_cast<CMPISint16>(std::get<std::int64_t>(value.content));
        break;
    case CMPI_sint32:
        result.sint32 = static_cast<CMPISint32>(std::get<std::int64_t>(value.content));
        break;
    case CMPI_sint64:
        result.sint64 = std::get<std::int64_t>(value.content);
        break;
    case CMPI_real32:
        result.real32 = static_cast<CMPIReal32>(std::get<double>(value.content));
        break;
    case CMPI_real64:
        result.real64 = std::get<double>(value.content);
        break;
    case CMPI_string:
        result.string = make<String_Object>(std::get<std::string>(value.content)).face();
        break;
    case CMPI_dateTime:
        result.dateTime = make<Datetime_Object>(std::get<std::string>(value.content)).face();
        break;
    case CMPI_ref:
        result.ref = make<Path_Object>(*std::get<std::shared_ptr<const Object_Path>>(value.content)).face();
        break;
    case CMPI_instance:
        result.inst = make<Instance_Object>(*std::get<std::shared_ptr<const Instance>>(value.content)).face();
        break;
    default:
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    }
    return result;
}

std::string quoted(const std::string& text)
{
    std::string result = "\"";
    for (const char c : text)
    {
        if (c == '"' || c == '\\')
            result += '\\';
        result += c;
    }
    return result + '"';
}

std::string key_text(const Value& value)
{
    if (const auto* flag = std::get_if<bool>(&value.content))
        return *flag ? "TRUE" : "FALSE";
    if (const auto* number = std::get_if<std::uint64_t>(&value.content))
        return std::to_string(*number);
    if (const auto* number = std::get_if<std::int64_t>(&value.content))
        return std::to_string(*number);
    if (const auto* number = std::get_if<double>(&value.content))
        return std::to_string(*number);
    if (const auto* text = std::get_if<std::string>(&value.content))
        return quoted(*text);
    if (const auto* path = std::get_if<std::shared_ptr<const Object_Path>>(&value.content); path && *path)
        return quoted(path_text(**path));
    return "NULL";
}

} // namespace

bool is_scalar(CMPIType type)
{
    constexpr CMPIType types[] = {CMPI_boolean, CMPI_char16,   CMPI_real32, CMPI_real64,  CMPI_uint8,  CMPI_uint16,
                                  CMPI_uint32,  CMPI_uint64,   CMPI_sint8,  CMPI_sint16,  CMPI_sint32, CMPI_sint64,
                                  CMPI_string,  CMPI_dateTime, CMPI_ref,    CMPI_instance};
    return std::find(std::begin(types), std::end(types), type) != std::end(types);
}

Value from_cmpi(const CMPIValue* value, CMPIType type)
{
    if (type == CMPI_null)
        return {};
    if (type == CMPI_chars)
        return {CMPI_string, value ? Value::Content(std::string(reinterpret_cast<const char*>(value))) : Value::Content()};
    if (type == array_of(CMPI_chars))
        type = array_of(CMPI_string);
    if (!is_scalar(element_of(type)))
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    if (!value)
        return {type, {}};
    return (type & CMPI_ARRAY) != 0 ? from_array(value->array, type) : from_scalar(*value, type);
}

CMPIData to_cmpi(const Value& value)
{
    CMPIData data{value.type, CMPI_goodValue, {.uint64 = 0}};
    if (value.null())
        data.state = CMPI_nullValue;
    else if ((value.type & CMPI_ARRAY) != 0)
        data.value.array = make<Array_Object>(element_of(value.type), std::get<std::vector<Value>>(value.content)).face();
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

void put(std::vector<Named_Value>& list, const char* name, Value value)
{
    if (Named_Value* found = find_named(list, required(name)))
        found->value = std::move(value);
    else
        list.push_back({name, std::move(value)});
}

std::string path_text(const Object_Path& path)
{
    std::string text = path.name_space.empty() ? path.class_name : path.name_space + ':' + path.class_name;
    char separator = '.';
    for (const Named_Value& key : path.keys)
    {
        text += separator + key.name + '=' + key_text(key.value);
        separator = ',';
    }
    return text;
}

} // namespace cimserver
