#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIData get_next(const CMPIEnumeration* self, CMPIStatus* status) noexcept
{
    return answer(status, no_data(),
                  [&]
                  {
                      auto& enumeration = object<Enumeration_Object>(self);
                      if (enumeration.next == enumeration.elements.size())
                          throw Failure{CMPI_RC_ERR_NOT_FOUND};
                      return to_cmpi(enumeration.elements[enumeration.next++]);
                  });
}

CMPIBoolean has_next(const CMPIEnumeration* self, CMPIStatus* status) noexcept
{
    return answer<CMPIBoolean>(status, 0,
                               [&]
                               {
                                   const auto& enumeration = object<Enumeration_Object>(self);
                                   return enumeration.next < enumeration.elements.size();
                               });
}

} // namespace

const CMPIEnumerationFT Enumeration_Object::table = {
    .ftVersion = 100,
    .release = release<Enumeration_Object>,
    .clone = clone<Enumeration_Object>,
    .getNext = get_next,
    .hasNext = has_next,
    .toArray = not_offered,
};

} // namespace cimserver
