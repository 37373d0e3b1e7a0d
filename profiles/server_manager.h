// ServerManager: the registered profiles, the CIM server as they show it, and the software that implements them. Nothing of this
// is read from an adapter: it is there with or without a driver.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

class ServerManager
{
public:
    static const ServerManager& getServerManager();

    // New instances of the class, CLASSID_RegisteredProfile to CLASSID_ProfileSoftwareIdentity; none of any other.
    Instance_Array getInstances(classId_t id, const Inventory_Request& request = {}) const;

private:
    ServerManager();
};

} // namespace zmlr
