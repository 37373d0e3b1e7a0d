#include "cmpi/cmpi_trace.h"

#include "runtime/log.h"

#include <cstdarg>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "CMPI_Adapter";

struct Rc_Name
{
    CMPIrc rc;
    const char* name;
};

// clang-format off
constexpr Rc_Name rc_names[] = {
    {CMPI_RC_OK,                               "CMPI_RC_OK"},
    {CMPI_RC_ERR_ACCESS_DENIED,                "CMPI_RC_ERR_ACCESS_DENIED"},
    {CMPI_RC_ERR_INVALID_NAMESPACE,            "CMPI_RC_ERR_INVALID_NAMESPACE"},
    {CMPI_RC_ERR_INVALID_PARAMETER,            "CMPI_RC_ERR_INVALID_PARAMETER"},
    {CMPI_RC_ERR_INVALID_CLASS,                "CMPI_RC_ERR_INVALID_CLASS"},
    {CMPI_RC_ERR_NOT_FOUND,                    "CMPI_RC_ERR_NOT_FOUND"},
    {CMPI_RC_ERR_NOT_SUPPORTED,                "CMPI_RC_ERR_NOT_SUPPORTED"},
    {CMPI_RC_ERR_CLASS_HAS_CHILDREN,           "CMPI_RC_ERR_CLASS_HAS_CHILDREN"},
    {CMPI_RC_ERR_CLASS_HAS_INSTANCES,          "CMPI_RC_ERR_CLASS_HAS_INSTANCES"},
    {CMPI_RC_ERR_INVALID_SUPERCLASS,           "CMPI_RC_ERR_INVALID_SUPERCLASS"},
    {CMPI_RC_ERR_ALREADY_EXISTS,               "CMPI_RC_ERR_ALREADY_EXISTS"},
    {CMPI_RC_ERR_NO_SUCH_PROPERTY,             "CMPI_RC_ERR_NO_SUCH_PROPERTY"},
    {CMPI_RC_ERR_TYPE_MISMATCH,                "CMPI_RC_ERR_TYPE_MISMATCH"},
    {CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED, "CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED"},
    {CMPI_RC_ERR_INVALID_QUERY,                "CMPI_RC_ERR_INVALID_QUERY"},
    {CMPI_RC_ERR_METHOD_NOT_AVAILABLE,         "CMPI_RC_ERR_METHOD_NOT_AVAILABLE"},
    {CMPI_RC_ERR_METHOD_NOT_FOUND,             "CMPI_RC_ERR_METHOD_NOT_FOUND"},
    {CMPI_RC_DO_NOT_UNLOAD,                    "CMPI_RC_DO_NOT_UNLOAD"},
    {CMPI_RC_NEVER_UNLOAD,                     "CMPI_RC_NEVER_UNLOAD"},
    {CMPI_RC_ERR_INVALID_HANDLE,               "CMPI_RC_ERR_INVALID_HANDLE"},
    {CMPI_RC_ERR_INVALID_DATA_TYPE,            "CMPI_RC_ERR_INVALID_DATA_TYPE"},
    {CMPI_RC_ERROR_SYSTEM,                     "CMPI_RC_ERROR_SYSTEM"},
    {CMPI_RC_ERROR,                            "CMPI_RC_ERROR"},
};
// clang-format on

} // namespace

void ent(const char* name, int line)
{
    if (log_wanted(LL_DBG))
        log(LL_DBG, log_source, line, "enter: %s()", name);
}

void ret(const char* name, int line)
{
    if (log_wanted(LL_DBG))
        log(LL_DBG, log_source, line, "return: %s()", name);
}

void ret(const char* name, CMPIrc rc, int line)
{
    if (log_wanted(LL_DBG))
        log(LL_DBG, log_source, line, "return: %s(): %s", name, _rc_to_str(rc));
}

void trc(int line, const char* format, ...)
{
    if (!log_wanted(LL_DBG))
        return;
    va_list arguments;
    va_start(arguments, format);
    vlog(LL_DBG, log_source, line, format, arguments);
    va_end(arguments);
}

const char* _rc_to_str(CMPIrc rc)
{
    for (const Rc_Name& row : rc_names)
    {
        if (row.rc == rc)
            return row.name;
    }
    return "CMPI_RC_ERR_FAILED";
}

} // namespace zmlr
