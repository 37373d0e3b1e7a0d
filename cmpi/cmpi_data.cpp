#include "cmpi/cmpi_data.h"

#include <utility>

namespace zmlr
{

CMPI_Data& CMPI_Data::operator=(CMPI_Data&& x) noexcept
{
    std::swap(_data, x._data);
    std::swap(_owner, x._owner);
    std::swap(_elements, x._elements);
    return *this;
}

void CMPI_Data::set(CMPIType type, const CMPIValue& value)
{
    release();
    _data = {type, CMPI_goodValue, value};
}

void CMPI_Data::set_null(CMPIType type)
{
    release();
    _data = {type, CMPI_nullValue, {.uint64 = 0}};
}

void CMPI_Data::own(CMPIType type, const CMPIValue& value)
{
    set(type, value);
    _owner = true;
}

bool CMPI_Data::adopt(CMPIString* string)
{
    if (!string)
        return false;
    CMPIValue value = {};
    value.string = string;
    own(CMPI_string, value);
    return true;
}

bool CMPI_Data::adopt(CMPIDateTime* datetime)
{
    if (!datetime)
        return false;
    CMPIValue value = {};
    value.dateTime = datetime;
    own(CMPI_dateTime, value);
    return true;
}

bool CMPI_Data::adopt(CMPIObjectPath* path)
{
    if (!path)
        return false;
    CMPIValue value = {};
    value.ref = path;
    own(CMPI_ref, value);
    return true;
}

bool CMPI_Data::adopt(CMPIInstance* instance)
{
    if (!instance)
        return false;
    CMPIValue value = {};
    value.inst = instance;
    own(CMPI_instance, value);
    return true;
}

bool CMPI_Data::adopt(CMPIArray* array, CMPIType element_type, std::vector<CMPI_Data> elements)
{
    if (!array)
        return false;
    CMPIValue value = {};
    value.array = array;
    own(static_cast<CMPIType>(element_type | CMPI_ARRAY), value);
    _elements = std::move(elements);
    return true;
}

void CMPI_Data::release()
{
    if (!_owner)
        return;
    _owner = false;
    const CMPI_Release release_object;
    if (CMIsArray(_data))
        release_object(_data.value.array);
    else if (_data.type == CMPI_string)
        release_object(_data.value.string);
    else if (_data.type == CMPI_dateTime)
        release_object(_data.value.dateTime);
    else if (_data.type == CMPI_ref)
        release_object(_data.value.ref);
    else
        release_object(_data.value.inst);
    _elements.clear();
}

} // namespace zmlr
