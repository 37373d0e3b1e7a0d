#include "cimserver/broker/return_code.h"

#include "cimserver/model/values.h"

#include <iterator>

namespace cimserver
{
namespace
{

// By their code.
constexpr const char* phrases[] = {
    "",
    "",
    "access denied",
    "there is no such name space",
    "a parameter is wrong",
    "the class is wrong",
    "not found",
    "",
    "the class has subclasses",
    "the class has instances",
    "the superclass is wrong",
    "it exists already",
    "there is no such property",
    "a value has the wrong type",
    "unknown query language",
    "the query is wrong",
    "the method is not available",
    "there is no such method",
};

constexpr bool is_shared(int code) { return code >= 1 && code < static_cast<int>(std::size(phrases)); }

} // namespace

std::string outcome_text(const std::string& class_name, const char* action, CMPIrc rc)
{
    if (rc == CMPI_RC_ERR_NOT_SUPPORTED)
        return class_name + " does not support " + action;
    if (is_shared(rc) && *phrases[rc])
        return class_name + ": " + action + ": " + phrases[rc];
    return class_name + ": " + action + " failed" + (rc == CMPI_RC_ERR_FAILED ? "" : " with code " + std::to_string(rc));
}

int cim_status(CMPIrc rc) { return is_shared(rc) ? rc : CIM_ERR_FAILED; }

CMPIrc return_code(int cim_status) { return is_shared(cim_status) ? static_cast<CMPIrc>(cim_status) : CMPI_RC_ERR_FAILED; }

} // namespace cimserver
