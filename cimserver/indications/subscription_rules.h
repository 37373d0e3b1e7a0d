// What a client may store as an indication filter, a listener's destination and a subscription (DSP1054), and how it is
// completed.
#pragma once

#include "cimserver/model/event_query.h"
#include "cimserver/model/repository.h"

namespace cimserver
{

// What a stored filter selects.
struct Event_Filter
{
    Event_Query query;
    const Class_Entry* entry; // of the query's class
};

// Each function takes an instance whose properties and keys are typed (interop/server_class.h) and returns it with all its
// keys, in its path and among its properties, and with what the server adds. SystemCreationClassName, SystemName
// and CreationClassName may be left out; Name may not. The texts of one are bounded. All throw Cim_Error, INVALID_PARAMETER
// unless they say otherwise.

// Query and QueryLanguage are needed. "WQL" and "DMTF:CQL" are spoken; another language is
// QUERY_LANGUAGE_NOT_SUPPORTED. No source name space means all that raise indications.
Instance complete_filter(Instance instance);

// The filter of a complete instance. Throws Cim_Error: INVALID_QUERY (event_query.h; also a class that is unknown or no
// indication), INVALID_PARAMETER for a source name space that raises no indications.
Event_Filter event_filter(const Instance& filter, const Repository& repository);

// Destination is the URL of a listener (delivery.h), Protocol 2 (CIM-XML). Left out, PersistenceType is 2 (permanent).
Instance complete_destination(Instance instance);

// Adds the state and the start. NOT_SUPPORTED for policies, a duration or a state that this server does not keep: it
// ignores fatal errors, does not suppress repetitions, and a subscription is enabled until it is deleted.
Instance complete_subscription(Instance instance);

} // namespace cimserver
