#include "cimserver/broker/return_code.h"

#include "cimserver/broker/model.h"

#include <algorithm>
#include <iterator>

namespace cimserver
{
namespace
{

struct Row
{
    int code;
    const char* name;
};

constexpr Row rows[] = {
    {0, "CMPI_RC_OK"},
    {1, "CMPI_RC_ERR_FAILED"},
    {2, "CMPI_RC_ERR_ACCESS_DENIED"},
    {3, "CMPI_RC_ERR_INVALID_NAMESPACE"},
    {4, "CMPI_RC_ERR_INVALID_PARAMETER"},
    {5, "CMPI_RC_ERR_INVALID_CLASS"},
    {6, "CMPI_RC_ERR_NOT_FOUND"},
    {7, "CMPI_RC_ERR_NOT_SUPPORTED"},
    {8, "CMPI_RC_ERR_CLASS_HAS_CHILDREN"},
    {9, "CMPI_RC_ERR_CLASS_HAS_INSTANCES"},
    {10, "CMPI_RC_ERR_INVALID_SUPERCLASS"},
    {11, "CMPI_RC_ERR_ALREADY_EXISTS"},
    {12, "CMPI_RC_ERR_NO_SUCH_PROPERTY"},
    {13, "CMPI_RC_ERR_TYPE_MISMATCH"},
    {14, "CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED"},
    {15, "CMPI_RC_ERR_INVALID_QUERY"},
    {16, "CMPI_RC_ERR_METHOD_NOT_AVAILABLE"},
    {17, "CMPI_RC_ERR_METHOD_NOT_FOUND"},
    {50, "CMPI_RC_DO_NOT_UNLOAD"},
    {51, "CMPI_RC_NEVER_UNLOAD"},
    {60, "CMPI_RC_ERR_INVALID_HANDLE"},
    {61, "CMPI_RC_ERR_INVALID_DATA_TYPE"},
    {100, "CMPI_RC_ERROR_SYSTEM"},
    {200, "CMPI_RC_ERROR"},
};

constexpr bool is_shared(int code) { return code >= 1 && code <= 17; }

} // namespace

std::string return_code_name(CMPIrc rc)
{
    const auto found = std::find_if(std::begin(rows), std::end(rows), [rc](const Row& row) { return row.code == rc; });
    return found == std::end(rows) ? "return code " + std::to_string(rc) : found->name;
}

int cim_status(CMPIrc rc) { return is_shared(rc) ? rc : CIM_ERR_FAILED; }

CMPIrc return_code(int cim_status) { return is_shared(cim_status) ? static_cast<CMPIrc>(cim_status) : CMPI_RC_ERR_FAILED; }

} // namespace cimserver
