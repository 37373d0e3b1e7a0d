#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIType checked_element_type(CMPIType type)
{
    if (type == CMPI_chars)
        return CMPI_string;
    if (!is_scalar(type))
        throw Failure{CMPI_RC_ERR_INVALID_DATA_TYPE};
    return type;
}

CMPICount checked_size(CMPICount size)
{
    if (size > Array_Object::max_size)
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return size;
}

Value& element(Array_Object& array, CMPICount index)
{
    if (index >= array.elements.size())
        throw Failure{CMPI_RC_ERR_NO_SUCH_PROPERTY};
    return array.elements[index];
}

CMPICount get_size(const CMPIArray* self, CMPIStatus* status) noexcept
{
    return answer<CMPICount>(status, 0, [&] { return static_cast<CMPICount>(object<Array_Object>(self).elements.size()); });
}

CMPIData get_element_at(const CMPIArray* self, CMPICount index, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return to_cmpi(element(object<Array_Object>(self), index)); });
}

CMPIStatus set_element_at(CMPIArray* self, CMPICount index, const CMPIValue* value, CMPIType type) noexcept
{
    return answer(
        [&]
        {
            auto& array = object<Array_Object>(self);
            Value& target = element(array, index);
            Value converted = from_cmpi(value, type);
            if (type != CMPI_null && converted.type != array.element_type)
                throw Failure{CMPI_RC_ERR_TYPE_MISMATCH};
            converted.type = array.element_type;
            target = std::move(converted);
        });
}

} // namespace

Array_Object::Array_Object(CMPICount size, CMPIType element_type_)
    : element_type(checked_element_type(element_type_))
    , elements(checked_size(size), Value{element_type, {}})
{
}

Array_Object::Array_Object(CMPIType element_type_, std::vector<Value> elements_)
    : element_type(checked_element_type(element_type_))
    , elements(std::move(elements_))
{
}

const CMPIArrayFT Array_Object::table = {
    .ftVersion = 100,
    .release = release<Array_Object>,
    .clone = clone<Array_Object>,
    .getSize = get_size,
    .getSimpleType = not_offered,
    .getElementAt = get_element_at,
    .setElementAt = set_element_at,
};

} // namespace cimserver
