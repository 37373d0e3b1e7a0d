// The classes whose instances are the server's own: meta-data of the standard classes of the interop name space, generated
// from server_schema.mof.
#pragma once

#include "cmpi/registration.h"

namespace cimserver
{

extern const zmlr::Meta_Class CIM_ManagedElement; // the abstract root of the others, but for the subscription
extern const zmlr::Meta_Class CIM_ObjectManager;
extern const zmlr::Meta_Class CIM_Namespace;
extern const zmlr::Meta_Class CIM_IndicationFilter;
extern const zmlr::Meta_Class CIM_ListenerDestination;
extern const zmlr::Meta_Class CIM_ListenerDestinationCIMXML; // derived from CIM_ListenerDestination
extern const zmlr::Meta_Class CIM_IndicationSubscription;    // association of a filter and a destination

// The list from which a Repository of these classes is made. No record has a provider procedure.
const zmlr::Registration* server_registrations();

} // namespace cimserver
