#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIString* get_string(const CMPISelectExp* self, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr, [&] { return make<String_Object>(object<Select_Object>(self).query).face(); });
}

CMPIBoolean evaluate(const CMPISelectExp*, const CMPIInstance*, CMPIStatus* status) noexcept
{
    return not_supported<CMPIBoolean>(status, 0);
}

CMPISelectCond* no_condition(const CMPISelectExp*, CMPIStatus* status) noexcept
{
    return not_supported<CMPISelectCond*>(status, nullptr);
}

CMPIBoolean evaluate_using_accessor(const CMPISelectExp*, CMPIAccessor*, void*, CMPIStatus* status) noexcept
{
    return not_supported<CMPIBoolean>(status, 0);
}

} // namespace

const CMPISelectExpFT Select_Object::table = {
    .ftVersion = 100,
    .release = release<Select_Object>,
    .clone = clone<Select_Object>,
    .evaluate = evaluate,
    .getString = get_string,
    .getDOC = no_condition,
    .getCOD = no_condition,
    .evaluateUsingAccessor = evaluate_using_accessor,
};

} // namespace cimserver
