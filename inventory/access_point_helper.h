// AccessPointHelper: where the web pages of the host's Quillon management agent are, while it runs.
#pragma once

#include "inventory/class_id.h"
#include "inventory/hba_info.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_RemoteServiceAccessPoint.h"

namespace zmlr
{

namespace ProviderUtil
{

// The agent's TCP port; 0 when no process of its name runs. Asks "ps", and waits at most 10 s for its answer.
int getAgentPort();

} // namespace ProviderUtil

// Null while the agent does not run. Of the record only the host is used.
Ref<ZEMLAR_RemoteServiceAccessPoint> getRemoteServiceAccessPointInstance(const _hbaInfo& info);

class AccessPointHelper
{
public:
    static const AccessPointHelper& getAccessPointHelperInstance();

    // The one access point of the class `id`; none while the agent does not run, or when the host has no usable name.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request = {}) const;

private:
    AccessPointHelper() = default;
};

} // namespace zmlr
