#include "cimserver/broker/conversion.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIData get_entry(const CMPIContext* self, const char* name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return data_named(object<Context_Object>(self).entries, name); });
}

CMPIData get_entry_at(const CMPIContext* self, CMPICount index, CMPIString** name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return data_at(object<Context_Object>(self).entries, index, name); });
}

CMPICount get_entry_count(const CMPIContext* self, CMPIStatus* status) noexcept
{
    return answer<CMPICount>(status, 0, [&] { return static_cast<CMPICount>(object<Context_Object>(self).entries.size()); });
}

CMPIStatus add_entry(const CMPIContext* self, const char* name, const CMPIValue* value, CMPIType type) noexcept
{
    return answer([&] { put(object<Context_Object>(self).entries, name, from_cmpi(value, type)); });
}

} // namespace

const CMPIContextFT Context_Object::table = {
    .ftVersion = 100,
    .release = release<Context_Object>,
    .clone = clone<Context_Object>,
    .getEntry = get_entry,
    .getEntryAt = get_entry_at,
    .getEntryCount = get_entry_count,
    .addEntry = add_entry,
};

} // namespace cimserver
