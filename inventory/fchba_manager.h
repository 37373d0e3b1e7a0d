// FCHBAManager: the way from providers to the helpers that build the instances of hosts, adapters, ports and services.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

class FCHBAManager
{
public:
    static const FCHBAManager& getFCHBAManager();

    // All instances of the class, new objects that the caller owns. Empty when there are none, when the class needs the
    // adapters and the driver gate is closed, or when no helper builds the class.
    Instance_Array getInstances(classId_t id, const Inventory_Request& request = {}) const;

    // The ZEMLAR_FCPort instances of the adapter with this MAC address or node WWN.
    Instance_Array getFCPortInstancesByAdapter(const String& address, const Inventory_Request& request = {}) const;

    // The ZEMLAR_EthernetPort instances of the adapter with this MAC address.
    Instance_Array getEthernetPortInstancesByAdapter(const String& mac, const Inventory_Request& request = {}) const;

    // The tests: every one, also when there is no driver; and those that can be run on an adapter, an FC port, an Ethernet port.
    Instance_Array getAllDiagnosticTestInstances(const Inventory_Request& request = {}) const;
    Instance_Array getDiagnosticServicesForAdapter(const Inventory_Request& request = {}) const;
    Instance_Array getDiagnosticServicesForFCPort(const Inventory_Request& request = {}) const;
    Instance_Array getDiagnosticServicesForEthernetPort(const Inventory_Request& request = {}) const;

private:
    FCHBAManager();
};

} // namespace zmlr
