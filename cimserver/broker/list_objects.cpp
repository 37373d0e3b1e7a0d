// The objects that hold a list: of named values, or of what an up-call found.
#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIStatus add_arg(const CMPIArgs* self, const char* name, const CMPIValue* value, CMPIType type) noexcept
{
    return answer([&] { put(object<Args_Object>(self).args, required(name), from_cmpi(value, type)); });
}

CMPIData get_arg_at(const CMPIArgs* self, CMPICount index, CMPIString** name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return data_at(object<Args_Object>(self).args, index, name); });
}

CMPICount get_arg_count(const CMPIArgs* self, CMPIStatus* status) noexcept
{
    return answer<CMPICount>(status, 0, [&] { return static_cast<CMPICount>(object<Args_Object>(self).args.size()); });
}

CMPIData get_entry(const CMPIContext* self, const char* name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return data_named(object<Context_Object>(self).entries, name); });
}

CMPIData get_next(const CMPIEnumeration* self, CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        auto& enumeration = object<Enumeration_Object>(self);
        if (enumeration.next == enumeration.elements.size())
            throw Failure{CMPI_RC_ERR_NOT_FOUND};
        return to_cmpi(enumeration.elements[enumeration.next++]);
    };
    return answer(status, no_data(), body);
}

CMPIBoolean has_next(const CMPIEnumeration* self, CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        const auto& enumeration = object<Enumeration_Object>(self);
        return enumeration.next < enumeration.elements.size();
    };
    return answer<CMPIBoolean>(status, 0, body);
}

} // namespace

const CMPIArgsFT Args_Object::table = {
    .ftVersion = 100,
    .release = release<Args_Object>,
    .clone = clone<Args_Object>,
    .addArg = add_arg,
    .getArg = not_offered,
    .getArgAt = get_arg_at,
    .getArgCount = get_arg_count,
};

const CMPIContextFT Context_Object::table = {
    .ftVersion = 100,
    .release = release<Context_Object>,
    .clone = clone<Context_Object>,
    .getEntry = get_entry,
    .getEntryAt = not_offered,
    .getEntryCount = not_offered,
    .addEntry = not_offered,
};

const CMPIEnumerationFT Enumeration_Object::table = {
    .ftVersion = 100,
    .release = release<Enumeration_Object>,
    .clone = clone<Enumeration_Object>,
    .getNext = get_next,
    .hasNext = has_next,
    .toArray = not_offered,
};

} // namespace cimserver
