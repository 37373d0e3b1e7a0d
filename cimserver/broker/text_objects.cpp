// The objects that hold one text.
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"
#include "text/datetime.h"

namespace cimserver
{
namespace
{

const char* get_char_ptr(const CMPIString* self, CMPIStatus* status) noexcept
{
    return answer<const char*>(status, nullptr, [&] { return object<String_Object>(self).text.c_str(); });
}

// Any numbers in the form: a timestamp of all zeros is what many agents answer for an unset clock.
Text checked(Text text)
{
    if (!text::read_datetime(text))
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return text;
}

CMPIString* get_string_format(const CMPIDateTime* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return object<Datetime_Object>(self).text; });
}

CMPIString* get_string(const CMPISelectExp* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return object<Select_Object>(self).query; });
}

} // namespace

const CMPIStringFT String_Object::table = {
    .ftVersion = 100,
    .release = release<String_Object>,
    .clone = clone<String_Object>,
    .getCharPtr = get_char_ptr,
};

Datetime_Object::Datetime_Object(Text text_) : text(checked(std::move(text_))) {}

const CMPIDateTimeFT Datetime_Object::table = {
    .ftVersion = 100,
    .release = release<Datetime_Object>,
    .clone = clone<Datetime_Object>,
    .getBinaryFormat = not_offered,
    .getStringFormat = get_string_format,
    .isInterval = not_offered,
};

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
