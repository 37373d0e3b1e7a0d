// The classes by which clients manage subscriptions: CIM_IndicationFilter, CIM_ListenerDestinationCIMXML and
// CIM_IndicationSubscription. Instances can be created, read and deleted.
#pragma once

#include "cimserver/indications/subscriptions.h"
#include "cimserver/interop/server_class.h"

#include <memory>

namespace cimserver
{

std::unique_ptr<Server_Class> make_subscription_class(Subscription_Kind kind,
                                                      Subscriptions& subscriptions); // which must outlive it

} // namespace cimserver
