#include "cmpi/status_to_rc.h"

namespace zmlr
{

CMPIrc to_rc(Enum_Instances_Status status)
{
    switch (status)
    {
    case ENUM_INSTANCES_FAILED:
        return CMPI_RC_ERR_FAILED;
    case ENUM_INSTANCES_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Get_Instance_Status status)
{
    switch (status)
    {
    case GET_INSTANCE_OK:
        return CMPI_RC_OK;
    case GET_INSTANCE_NOT_FOUND:
        return CMPI_RC_ERR_NOT_FOUND;
    case GET_INSTANCE_INVALID_PARAMETER:
        return CMPI_RC_ERR_INVALID_PARAMETER;
    case GET_INSTANCE_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    default:
        return CMPI_RC_ERR_FAILED;
    }
}

CMPIrc to_rc(Create_Instance_Status status)
{
    switch (status)
    {
    case CREATE_INSTANCE_DUPLICATE:
        return CMPI_RC_ERR_ALREADY_EXISTS;
    case CREATE_INSTANCE_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case CREATE_INSTANCE_INVALID_PARAMETER:
        return CMPI_RC_ERR_INVALID_PARAMETER;
    case CREATE_INSTANCE_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    case CREATE_INSTANCE_FAILED:
        return CMPI_RC_ERR_FAILED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Modify_Instance_Status status)
{
    switch (status)
    {
    case MODIFY_INSTANCE_NOT_FOUND:
        return CMPI_RC_ERR_NOT_FOUND;
    case MODIFY_INSTANCE_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case MODIFY_INSTANCE_INVALID_PARAMETER:
        return CMPI_RC_ERR_INVALID_PARAMETER;
    case MODIFY_INSTANCE_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    case MODIFY_INSTANCE_FAILED:
        return CMPI_RC_ERR_FAILED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Delete_Instance_Status status)
{
    switch (status)
    {
    case DELETE_INSTANCE_NOT_FOUND:
        return CMPI_RC_ERR_NOT_FOUND;
    case DELETE_INSTANCE_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case DELETE_INSTANCE_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    case DELETE_INSTANCE_FAILED:
        return CMPI_RC_ERR_FAILED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Enum_Associators_Status status)
{
    switch (status)
    {
    case ENUM_ASSOCIATORS_FAILED:
        return CMPI_RC_ERR_FAILED;
    case ENUM_ASSOCIATORS_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case ENUM_ASSOCIATORS_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Enum_Associator_Names_Status status)
{
    switch (status)
    {
    case ENUM_ASSOCIATOR_NAMES_FAILED:
        return CMPI_RC_ERR_FAILED;
    case ENUM_ASSOCIATOR_NAMES_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Enum_References_Status status)
{
    switch (status)
    {
    case ENUM_REFERENCES_FAILED:
        return CMPI_RC_ERR_FAILED;
    case ENUM_REFERENCES_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case ENUM_REFERENCES_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Invoke_Method_Status status)
{
    switch (status)
    {
    case INVOKE_METHOD_FAILED:
        return CMPI_RC_ERR_FAILED;
    case INVOKE_METHOD_UNSUPPORTED:
        return CMPI_RC_ERR_NOT_SUPPORTED;
    case INVOKE_METHOD_ACCESS_DENIED:
        return CMPI_RC_ERR_ACCESS_DENIED;
    default:
        return CMPI_RC_OK;
    }
}

CMPIrc to_rc(Enable_Indications_Status status) { return status == ENABLE_INDICATIONS_FAILED ? CMPI_RC_ERR_FAILED : CMPI_RC_OK; }

CMPIrc to_rc(Disable_Indications_Status status) { return status == DISABLE_INDICATIONS_FAILED ? CMPI_RC_ERR_FAILED : CMPI_RC_OK; }

} // namespace zmlr
