#include "cmpi/cmpi_data.h"

namespace zmlr
{

CMPI_Data& CMPI_Data::operator=(CMPI_Data&& x) noexcept
{
    std::swap(_data, x._data);
    std::swap(_release, x._release);
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

void CMPI_Data::release()
{
    if (auto* release_object = std::exchange(_release, nullptr))
        release_object(_data.value);
    _elements.clear();
}

} // namespace zmlr
