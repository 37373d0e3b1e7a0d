#include "cmpi/cmpi_objects.h"

#include "runtime/log.h"

namespace zmlr
{

const char* chars_of(const CMPIString* string)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const char* text = string ? CMGetCharsPtr(string, &status) : nullptr;
    return okay(status) ? text : nullptr;
}

namespace
{

constexpr const char* log_source = "CMPI_Objects";

String to_string(const CMPIString* string, const CMPIStatus& status)
{
    if (const char* text = okay(status) ? chars_of(string) : nullptr)
        return text;
    if (string)
        ZMLR_LOG(LL_WARN, "CMGetCharsPtr() failed");
    return {};
}

} // namespace

String name_space_of(const CMPIObjectPath* path)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIString* text = path ? CMGetNameSpace(path, &status) : nullptr;
    return to_string(text, status);
}

String class_name_of(const CMPIObjectPath* path)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIString* text = path ? CMGetClassName(path, &status) : nullptr;
    return to_string(text, status);
}

} // namespace zmlr
