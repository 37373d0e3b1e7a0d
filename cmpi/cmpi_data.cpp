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

void CMPI_Data::release_object()
{
    std::exchange(_release, nullptr)(_data.value);
    _elements.clear();
}

} // namespace zmlr
