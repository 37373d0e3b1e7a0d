// ZEMLAR_SCSIProtocolEndpoint: one end of what an FC port speaks SCSI with: the port itself, or a remote port.
#pragma once

#include "inventory/hba_port_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_SCSIProtocolEndpoint.h"

namespace zmlr
{

// The endpoint named by the record's address: the port as initiator, or a target endpoint (which has the port's status).
Ref<ZEMLAR_SCSIProtocolEndpoint> getSCSIProtocolEndpointInstance(const _hbaPortInfo& info, bool is_initiator);

} // namespace zmlr
