// What the rows of joins_inventory.h need that is special to them: whose ports are asked for, keys that are no properties, and
// matches that are more than equal keys.
#pragma once

#include "inventory/inventory_request.h"
#include "providers/join.h"

#include <cstdio>

namespace zmlr
{

// ---- sides of an element ----

Instance_Array fc_ports_of(const ZEMLAR_PortController& controller, const Inventory_Request& request);
Instance_Array ethernet_ports_of(const ZEMLAR_PortController& controller, const Inventory_Request& request);
Instance_Array ethernet_ports_beside(const ZEMLAR_PhysicalConnector& connector,
                                     const Inventory_Request& request); // of its adapter

// ---- keys ----

// The address of the adapter whose card the package is; empty for a model that is not known.
String address_in_tag(const ZEMLAR_PhysicalPackage& package);

template <class Port> String number_of(const Port& port)
{
    char text[8];
    std::snprintf(text, sizeof text, "%u", port.PortNumber.value);
    return port.PortNumber.null ? String() : String(text);
}

// ---- matches; the sides are those of their row ----

// Firmware and boot code belong to the controller whose address they are named by, drivers to all controllers. An FC HBA has no
// network driver. In the order of the controllers.
void software_on_controllers(Joining& joining);

// A connector is in the package of the adapter whose index stands in its tag. In the order of the packages.
void connectors_in_packages(Joining& joining);

// A connector is that of the adapter's port whose indexes stand in its tag.
void ports_at_connectors(Joining& joining);

// A unit's identifier begins with the addresses of the initiator and of the target through which it is reached.
void paths_to_units(Joining& joining);

} // namespace zmlr
