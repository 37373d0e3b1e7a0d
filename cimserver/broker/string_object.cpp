#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

const char* get_char_ptr(const CMPIString* self, CMPIStatus* status) noexcept
{
    return answer<const char*>(status, nullptr, [&] { return (*object<String_Object>(self).text).c_str(); });
}

} // namespace

const CMPIStringFT String_Object::table = {
    .ftVersion = 100,
    .release = release<String_Object>,
    .clone = clone<String_Object>,
    .getCharPtr = get_char_ptr,
};

} // namespace cimserver
