// The way of a CIM server into a provider and out of it: what every factory function calls, and what every cleanup ends in.
//
// Both hold one lock of the process, so that factories of one provider may race. (A provider that unloads must not wait for
// a thread that may ask the server for another interface of this module.)
#pragma once

#include "cmpi/adapter.h"

namespace zmlr
{

// What a cleanup function of any interface does: keeps everything and answers CMPI_RC_DO_NOT_UNLOAD while unloading is not
// allowed (a terminating server is not asked), else gives up one interface; with the last one the provider is unloaded and
// the adapter destroyed.
CMPIrc cleanup(CMPI_Adapter* adapter, bool terminating);

} // namespace zmlr

// Answers in *mi the management interface of a provider: `kind` is 'I' instance, 'M' method, 'A' association or 'N'
// indication; any other one answers null. All interfaces of a provider share one adapter, which the first call makes with its
// broker and context. `language` is always 'C'. Returns 0; -1 and a null interface when no adapter could be made.
extern "C" [[gnu::visibility("default")]] int cimple_cmpi_adapter(char language, zmlr::CMPI_Static_Data* sd,
                                                                  const zmlr::Registration* registration,
                                                                  const CMPIBroker* broker, const CMPIContext* context,
                                                                  const char* provider_name, char kind, void** mi) noexcept;
