#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"
#include "text/datetime.h"

namespace cimserver
{
namespace
{

// Any numbers in the form: a timestamp of all zeros is what many agents answer for an unset clock.
Shared<std::string> checked(Shared<std::string> text)
{
    if (!text::read_datetime(*text))
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return text;
}

CMPIString* get_string_format(const CMPIDateTime* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return object<Datetime_Object>(self).text; });
}

} // namespace

Datetime_Object::Datetime_Object(Shared<std::string> text_) : text(checked(std::move(text_))) {}

const CMPIDateTimeFT Datetime_Object::table = {
    .ftVersion = 100,
    .release = release<Datetime_Object>,
    .clone = clone<Datetime_Object>,
    .getBinaryFormat = not_offered,
    .getStringFormat = get_string_format,
    .isInterval = not_offered,
};

} // namespace cimserver
