#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

template <class T> T valid(std::optional<T> result)
{
    if (!result)
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return *std::move(result);
}

CMPIUint64 get_binary_format(const CMPIDateTime* self, CMPIStatus* status) noexcept
{
    return answer<CMPIUint64>(status, 0, [&] { return object<Datetime_Object>(self).value.microseconds; });
}

CMPIString* get_string_format(const CMPIDateTime* self, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr, [&] { return make<String_Object>(object<Datetime_Object>(self).text).face(); });
}

CMPIBoolean is_interval(const CMPIDateTime* self, CMPIStatus* status) noexcept
{
    return answer<CMPIBoolean>(status, 0, [&] { return object<Datetime_Object>(self).value.interval; });
}

} // namespace

Datetime_Object::Datetime_Object(std::string text_) : text(std::move(text_)), value(valid(parse_datetime(text))) {}

Datetime_Object::Datetime_Object(const Datetime_Value& value_) : text(valid(format_datetime(value_))), value(value_) {}

const CMPIDateTimeFT Datetime_Object::table = {
    .ftVersion = 100,
    .release = release<Datetime_Object>,
    .clone = clone<Datetime_Object>,
    .getBinaryFormat = get_binary_format,
    .getStringFormat = get_string_format,
    .isInterval = is_interval,
};

} // namespace cimserver
