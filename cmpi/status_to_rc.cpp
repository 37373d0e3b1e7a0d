#include "cmpi/status_to_rc.h"

#include <cstddef>

namespace zmlr
{

namespace
{

struct Row
{
    sint32 status;
    CMPIrc rc;
};

// clang-format off
constexpr Row enum_instances[] = {
    {ENUM_INSTANCES_FAILED,        CMPI_RC_ERR_FAILED},
    {ENUM_INSTANCES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
};
constexpr Row get_instance[] = {
    {GET_INSTANCE_OK,                CMPI_RC_OK},
    {GET_INSTANCE_NOT_FOUND,         CMPI_RC_ERR_NOT_FOUND},
    {GET_INSTANCE_INVALID_PARAMETER, CMPI_RC_ERR_INVALID_PARAMETER},
    {GET_INSTANCE_ACCESS_DENIED,     CMPI_RC_ERR_ACCESS_DENIED},
};
constexpr Row create_instance[] = {
    {CREATE_INSTANCE_DUPLICATE,         CMPI_RC_ERR_ALREADY_EXISTS},
    {CREATE_INSTANCE_UNSUPPORTED,       CMPI_RC_ERR_NOT_SUPPORTED},
    {CREATE_INSTANCE_INVALID_PARAMETER, CMPI_RC_ERR_INVALID_PARAMETER},
    {CREATE_INSTANCE_ACCESS_DENIED,     CMPI_RC_ERR_ACCESS_DENIED},
    {CREATE_INSTANCE_FAILED,            CMPI_RC_ERR_FAILED},
};
constexpr Row modify_instance[] = {
    {MODIFY_INSTANCE_NOT_FOUND,         CMPI_RC_ERR_NOT_FOUND},
    {MODIFY_INSTANCE_UNSUPPORTED,       CMPI_RC_ERR_NOT_SUPPORTED},
    {MODIFY_INSTANCE_INVALID_PARAMETER, CMPI_RC_ERR_INVALID_PARAMETER},
    {MODIFY_INSTANCE_ACCESS_DENIED,     CMPI_RC_ERR_ACCESS_DENIED},
    {MODIFY_INSTANCE_FAILED,            CMPI_RC_ERR_FAILED},
};
constexpr Row delete_instance[] = {
    {DELETE_INSTANCE_NOT_FOUND,     CMPI_RC_ERR_NOT_FOUND},
    {DELETE_INSTANCE_UNSUPPORTED,   CMPI_RC_ERR_NOT_SUPPORTED},
    {DELETE_INSTANCE_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
    {DELETE_INSTANCE_FAILED,        CMPI_RC_ERR_FAILED},
};
constexpr Row enum_associators[] = {
    {ENUM_ASSOCIATORS_FAILED,        CMPI_RC_ERR_FAILED},
    {ENUM_ASSOCIATORS_UNSUPPORTED,   CMPI_RC_ERR_NOT_SUPPORTED},
    {ENUM_ASSOCIATORS_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
};
constexpr Row enum_associator_names[] = {
    {ENUM_ASSOCIATOR_NAMES_FAILED,        CMPI_RC_ERR_FAILED},
    {ENUM_ASSOCIATOR_NAMES_UNSUPPORTED,   CMPI_RC_ERR_NOT_SUPPORTED},
    {ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
};
constexpr Row enum_references[] = {
    {ENUM_REFERENCES_FAILED,        CMPI_RC_ERR_FAILED},
    {ENUM_REFERENCES_UNSUPPORTED,   CMPI_RC_ERR_NOT_SUPPORTED},
    {ENUM_REFERENCES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
};
constexpr Row invoke_method[] = {
    {INVOKE_METHOD_FAILED,        CMPI_RC_ERR_FAILED},
    {INVOKE_METHOD_UNSUPPORTED,   CMPI_RC_ERR_NOT_SUPPORTED},
    {INVOKE_METHOD_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED},
};
constexpr Row enable_indications[]  = {{ENABLE_INDICATIONS_FAILED,  CMPI_RC_ERR_FAILED}};
constexpr Row disable_indications[] = {{DISABLE_INDICATIONS_FAILED, CMPI_RC_ERR_FAILED}};
// clang-format on

template <std::size_t N> CMPIrc rc_of(sint32 status, const Row (&rows)[N], CMPIrc others = CMPI_RC_OK)
{
    for (const Row& row : rows)
    {
        if (row.status == status)
            return row.rc;
    }
    return others;
}

} // namespace

CMPIrc to_rc(Enum_Instances_Status status) { return rc_of(status, enum_instances); }
CMPIrc to_rc(Get_Instance_Status status) { return rc_of(status, get_instance, CMPI_RC_ERR_FAILED); }
CMPIrc to_rc(Create_Instance_Status status) { return rc_of(status, create_instance); }
CMPIrc to_rc(Modify_Instance_Status status) { return rc_of(status, modify_instance); }
CMPIrc to_rc(Delete_Instance_Status status) { return rc_of(status, delete_instance); }
CMPIrc to_rc(Enum_Associators_Status status) { return rc_of(status, enum_associators); }
CMPIrc to_rc(Enum_Associator_Names_Status status) { return rc_of(status, enum_associator_names); }
CMPIrc to_rc(Enum_References_Status status) { return rc_of(status, enum_references); }
CMPIrc to_rc(Invoke_Method_Status status) { return rc_of(status, invoke_method); }
CMPIrc to_rc(Enable_Indications_Status status) { return rc_of(status, enable_indications); }
CMPIrc to_rc(Disable_Indications_Status status) { return rc_of(status, disable_indications); }

} // namespace zmlr
