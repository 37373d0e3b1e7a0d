#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIData get_entry(const CMPIContext* self, const char* name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return data_named(object<Context_Object>(self).entries, name); });
}

} // namespace

const CMPIContextFT Context_Object::table = {
    .ftVersion = 100,
    .release = release<Context_Object>,
    .clone = clone<Context_Object>,
    .getEntry = get_entry,
    .getEntryAt = not_offered,
    .getEntryCount = not_offered,
    .addEntry = not_offered,
};

} // namespace cimserver
