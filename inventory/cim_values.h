// Value maps of the CIM schema, of the properties whose values this module derives from driver states.
#pragma once

#include "runtime/types.h"

namespace zmlr
{

// CIM_ManagedSystemElement.OperationalStatus
enum Operational_Status : uint16
{
    OPERATIONAL_STATUS_UNKNOWN = 0,
    OPERATIONAL_STATUS_OK = 2,
    OPERATIONAL_STATUS_ERROR = 6,
    OPERATIONAL_STATUS_STARTING = 8,
    OPERATIONAL_STATUS_STOPPING = 9,
    OPERATIONAL_STATUS_STOPPED = 10,
    OPERATIONAL_STATUS_IN_SERVICE = 11,
    OPERATIONAL_STATUS_LOST_COMMUNICATION = 13
};

// CIM_EnabledLogicalElement.EnabledState
enum Enabled_State : uint16
{
    ENABLED_STATE_OTHER = 1,
    ENABLED_STATE_ENABLED = 2,
    ENABLED_STATE_DISABLED = 3,
    ENABLED_STATE_SHUTTING_DOWN = 4,
    ENABLED_STATE_OFFLINE = 6, // enabled but offline
    ENABLED_STATE_QUIESCE = 9
};

// CIM_FCPort.PortType
enum FC_Port_Type : uint16
{
    FC_PORT_TYPE_UNKNOWN = 0,
    FC_PORT_TYPE_N = 10,
    FC_PORT_TYPE_NL = 11
};

// CIM_AlarmDevice.AlarmState
enum Alarm_State : uint16
{
    ALARM_STATE_OFF = 1,
    ALARM_STATE_ALTERNATING = 3
};

// CIM_SoftwareInstallationService.InstallFromURI, InstallOptions, and what the service's capabilities tell of them
enum Install_Option : uint16
{
    INSTALL_OPTION_INSTALL = 4,
    INSTALL_OPTION_UPDATE = 5
};

// CIM_PortController.ControllerType
enum Controller_Type : uint16
{
    CONTROLLER_TYPE_OTHER = 1,
    CONTROLLER_TYPE_FC = 4
};

} // namespace zmlr
