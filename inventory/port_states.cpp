#include "inventory/port_states.h"

#include "hxal/hxal.h"
#include "inventory/cim_values.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

} // namespace

uint16 getPortState(uint32 port_state)
{
    const Scope_Trace trace(log_source);
    switch (port_state)
    {
    case HXA_PPORT_ST_ENABLING_QWAIT:
    case HXA_PPORT_ST_ENABLING:
        return OPERATIONAL_STATUS_STARTING;
    case HXA_PPORT_ST_LINKDOWN:
        return OPERATIONAL_STATUS_LOST_COMMUNICATION;
    case HXA_PPORT_ST_LINKUP:
        return OPERATIONAL_STATUS_IN_SERVICE;
    case HXA_PPORT_ST_DISABLING_QWAIT:
    case HXA_PPORT_ST_DISABLING:
        return OPERATIONAL_STATUS_STOPPING;
    case HXA_PPORT_ST_DISABLED:
    case HXA_PPORT_ST_STOPPED:
        return OPERATIONAL_STATUS_STOPPED;
    case HXA_PPORT_ST_IOCDOWN:
        return OPERATIONAL_STATUS_ERROR;
    default:
        return OPERATIONAL_STATUS_UNKNOWN;
    }
}

uint16 getEnabledState(uint16 operational_status)
{
    switch (operational_status)
    {
    case OPERATIONAL_STATUS_STARTING:
        return ENABLED_STATE_QUIESCE;
    case OPERATIONAL_STATUS_STOPPING:
        return ENABLED_STATE_SHUTTING_DOWN;
    case OPERATIONAL_STATUS_STOPPED:
        return ENABLED_STATE_DISABLED;
    case OPERATIONAL_STATUS_IN_SERVICE:
        return ENABLED_STATE_ENABLED;
    case OPERATIONAL_STATUS_LOST_COMMUNICATION:
        return ENABLED_STATE_OFFLINE;
    default:
        return ENABLED_STATE_OTHER;
    }
}

uint16 getPortType(uint32 port_type)
{
    const Scope_Trace trace(log_source);
    switch (port_type)
    {
    case HXA_PPORT_TYPE_TRUNKED:
    case HXA_PPORT_TYPE_NPORT:
    case HXA_PPORT_TYPE_P2P:
    case HXA_PPORT_TYPE_VPORT:
        return FC_PORT_TYPE_N;
    case HXA_PPORT_TYPE_NLPORT:
    case HXA_PPORT_TYPE_LPORT:
        return FC_PORT_TYPE_NL;
    default:
        return FC_PORT_TYPE_UNKNOWN;
    }
}

} // namespace zmlr
