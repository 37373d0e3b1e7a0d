// The way of a CIM server into a provider and out of it: what every factory function calls, and what every cleanup ends in.
//
// One lock of the process guards which adapters there are, so that factories and cleanups may race. Nobody waits for another
// thread while holding it.
#pragma once

#include "cmpi/adapter.h"

#include <mutex>

namespace zmlr
{

class Thread_Context;

// Recursive: a provider that loads may call into the server, which may ask for another provider of this module.
extern constinit std::recursive_mutex life_lock;

// What a cleanup function of any interface does: keeps everything and answers CMPI_RC_DO_NOT_UNLOAD while unloading is not
// allowed (a terminating server is not asked), else gives up one interface. With the last one the provider goes: requests
// that still run are waited for and new ones refused, the provider is unloaded, its threads leave the broker for good, and
// the adapter is destroyed. A thread that works for the provider cannot wait for itself, nor can one that is making an adapter:
// its last cleanup keeps everything and answers CMPI_RC_DO_NOT_UNLOAD too. `caller` is that thread's context before the cleanup's
// own (null: none).
CMPIrc cleanup(CMPI_Adapter* adapter, bool terminating, const Thread_Context* caller);

// A request's hold on the adapter of its interface, which stays for this long.
class Adapter_Use
{
public:
    template <class MI> explicit Adapter_Use(MI* mi)
    {
        const std::lock_guard guard(life_lock);
        CMPI_Adapter* adapter = CMPI_Adapter::of(mi);
        if (adapter->requests.enter())
            _adapter = adapter;
    }
    ~Adapter_Use()
    {
        if (_adapter)
            _adapter->requests.leave();
    }
    Adapter_Use(const Adapter_Use&) = delete;
    Adapter_Use& operator=(const Adapter_Use&) = delete;

    CMPI_Adapter* adapter() const { return _adapter; } // null when the adapter is going

private:
    CMPI_Adapter* _adapter = nullptr;
};

} // namespace zmlr

// Answers in *mi the management interface of a provider: `kind` is 'I' instance, 'M' method, 'A' association or 'N'
// indication; any other one answers null. All interfaces of a provider share one adapter, which the first call makes with its
// broker and context. `language` is always 'C'. Returns 0; -1 and a null interface when no adapter could be made. A call that
// finds the provider's adapter on its way out waits until it is gone, and makes a new one; it fails where waiting would be for
// ever: within a request or a thread of a provider that goes, and within another factory call.
extern "C" [[gnu::visibility("default")]] int cimple_cmpi_adapter(char language, zmlr::CMPI_Static_Data* sd,
                                                                  const zmlr::Registration* registration,
                                                                  const CMPIBroker* broker, const CMPIContext* context,
                                                                  const char* provider_name, char kind, void** mi) noexcept;
