#include "cimserver/cimxml/default_value.h"

#include "cimserver/model/value_text.h"
#include "runtime/types.h"

namespace cimserver
{
namespace
{

// The element of a default at `data`, moved on by its size. Texts are pointers.
template <class T> T next(const void*& data)
{
    const T* element = static_cast<const T*>(data);
    data = element + 1;
    return *element;
}

Value::Content next_content(unsigned type, const void*& data)
{
    switch (type)
    {
    case zmlr::BOOLEAN:
        return next<bool>(data);
    case zmlr::UINT8:
        return std::uint64_t{next<std::uint8_t>(data)};
    case zmlr::SINT8:
        return std::int64_t{next<std::int8_t>(data)};
    case zmlr::UINT16:
    case zmlr::CHAR16:
        return std::uint64_t{next<std::uint16_t>(data)};
    case zmlr::SINT16:
        return std::int64_t{next<std::int16_t>(data)};
    case zmlr::UINT32:
        return std::uint64_t{next<std::uint32_t>(data)};
    case zmlr::SINT32:
        return std::int64_t{next<std::int32_t>(data)};
    case zmlr::UINT64:
        return next<std::uint64_t>(data);
    case zmlr::SINT64:
        return next<std::int64_t>(data);
    case zmlr::REAL32:
        return double{next<float>(data)};
    case zmlr::REAL64:
        return next<double>(data);
    case zmlr::STRING:
    case zmlr::DATETIME:
        return std::string(next<const char*>(data));
    default:
        return std::monostate();
    }
}

} // namespace

Value default_of(const zmlr::Meta_Property& property)
{
    const CMPIType type = cmpi_type(property.type);
    const bool array = property.subscript != 0;
    Value value{array ? array_of(type) : type, {}};
    if (!property.value || (!property.value->data && (!array || property.value->size > 0)))
        return value;

    // A scalar text stands at the pointer itself, an array holds pointers to texts.
    const auto* const text = static_cast<const char*>(property.value->data);
    const bool text_itself = !array && (type == CMPI_string || type == CMPI_dateTime);
    const void* data = text_itself ? static_cast<const void*>(&text) : text;
    std::vector<Value> elements;
    for (unsigned i = 0; i < property.value->size; ++i)
        elements.push_back({type, next_content(property.type, data)});
    if (array)
        value.content = std::move(elements);
    else if (!elements.empty())
        value.content = std::move(elements.front().content);
    return value;
}

} // namespace cimserver
