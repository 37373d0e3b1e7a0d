// What the access library calls for each event of an adapter, an FC port, its audit trail or an Ethernet port. The last
// three turn one event into an alert and leave it with the IndicationHelper. The adapter's only traces: cards that come and go
// make no alert.
//
// The library calls them on its event thread, one at a time. An event that the message table does not know makes no alert, nor
// does one that is not supported, or that there is no memory for; the log tells.
#pragma once

#include "hxal/aen.h"

namespace zmlr
{

void adapterEventCallback(void* user_data, uint32_t event, const hxa_adapter_aen_data_t* data, hxa_timeval_t time) noexcept;
void pPortEventCallback(void* user_data, uint32_t event, const hxa_port_aen_data_t* data, hxa_timeval_t time) noexcept;
void auditEventCallback(void* user_data, uint32_t event, const hxa_audit_aen_data_t* data, hxa_timeval_t time) noexcept;
void ethPortEventCallback(void* user_data, uint32_t event, const hxa_ethport_aen_data_t* data, hxa_timeval_t time) noexcept;

} // namespace zmlr
