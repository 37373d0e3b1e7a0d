#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIString* get_string(const CMPISelectExp* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return object<Select_Object>(self).query; });
}

} // namespace

const CMPISelectExpFT Select_Object::table = {
    .ftVersion = 100,
    .release = release<Select_Object>,
    .clone = clone<Select_Object>,
    .evaluate = not_offered,
    .getString = get_string,
    .getDOC = not_offered,
    .getCOD = not_offered,
    .evaluateUsingAccessor = not_offered,
};

} // namespace cimserver
