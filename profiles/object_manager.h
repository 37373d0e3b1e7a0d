// The CIM server in the model: the object manager, its name space and the way to talk to it; one instance of each.
// CreationClassName is the name of `id`.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

// ZEMLAR_ObjectManager and ZEMLAR_Namespace, under the name that the server gives itself: each asks it once. Empty while the
// calling thread is asking already (own_object_manager.h).
Instance_Array getObjectManagerInstance(classId_t id, const Inventory_Request& request);
Instance_Array getNamespaceInstances(classId_t id, const Inventory_Request& request);

Instance_Array getCIMXMLCommunicationMechanismInstance(classId_t id,
                                                       const Inventory_Request& request); // ZEMLAR_CIMXMLCommunicationMechanism

} // namespace zmlr
