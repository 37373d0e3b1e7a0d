#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIStatus return_data(const CMPIResult* self, const CMPIValue* value, CMPIType type) noexcept
{
    return answer([&] { object<Result_Object>(self).sink.take_data(from_cmpi(value, type)); });
}

CMPIStatus return_instance(const CMPIResult* self, const CMPIInstance* instance) noexcept
{
    return answer([&] { object<Result_Object>(self).sink.take_instance(object<Instance_Object>(instance)); });
}

CMPIStatus return_object_path(const CMPIResult* self, const CMPIObjectPath* path) noexcept
{
    return answer([&] { object<Result_Object>(self).sink.take_path(object<Path_Object>(path).path); });
}

// The end of a request is its return; providers need not mark it.
CMPIStatus return_done(const CMPIResult* self) noexcept
{
    return answer([&] { object<Result_Object>(self); });
}

} // namespace

const CMPIResultFT Result_Object::table = {
    .ftVersion = 100,
    .release = release<Result_Object>,
    .clone = not_offered,
    .returnData = return_data,
    .returnInstance = return_instance,
    .returnObjectPath = return_object_path,
    .returnDone = return_done,
};

} // namespace cimserver
