// The alert provider: while indications are enabled its delivery thread hands one alert in 20 ms over to the CIM server.
#include "indications/indication_manager.h"
#include "providers/ZEMLAR_AlertIndication_Provider_Skeleton.h"
#include "runtime/log.h"
#include "runtime/thread.h"
#include "runtime/time.h"
#include "runtime/trace.h"

#include <atomic>
#include <exception>
#include <memory>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ZEMLAR_AlertIndication_Provider";
constexpr uint64 cycle = 20 * Time::MSEC;

using Alert_Handler = Indication_Handler<ZEMLAR_AlertIndication>;

// Enabling and disabling take turns (the adapter sees to that). Enabling is called under the adapter's lock, which a delivery
// takes: it never waits for the delivery thread, but makes it last, when nothing can fail any more. The events' thread takes no
// such lock and may be waited for.
class ZEMLAR_AlertIndication_Provider final : public ZEMLAR_AlertIndication_Provider_Skeleton
{
public:
    Load_Status load() override
    {
        ZMLR_LOG(LL_DBG, "ZEMLAR_AlertIndication_Provider::load()");
        return LOAD_OK;
    }

    Unload_Status unload() override
    {
        ZMLR_LOG(LL_DBG, "ZEMLAR_AlertIndication_Provider::unload()");
        if (_handler)
            disable_indications();
        _manager.releaseIndicationObjects();
        return UNLOAD_OK;
    }

    Enable_Indications_Status enable_indications(Alert_Handler* handler) override
    {
        std::unique_ptr<Alert_Handler> owned(handler);
        const Scope_Trace trace(log_source);
        if (_handler)
            return ENABLE_INDICATIONS_OK;
        if (!_manager.subscribeForEventNotifications())
        {
            ZMLR_LOG(LL_ERR, "Subscribtion for event notifications FAILED.");
            return ENABLE_INDICATIONS_FAILED;
        }
        _handler = std::move(owned);
        ZMLR_LOG(LL_INFO, "Subscribtion for event notifications is successful.");
        ++_running;
        if (start_delivery())
            return ENABLE_INDICATIONS_OK;
        --_running;
        _handler.reset();
        _manager.unsubscribeForEventNotifications();
        return ENABLE_INDICATIONS_FAILED;
    }

    Disable_Indications_Status disable_indications() override
    {
        const Scope_Trace trace(log_source);
        if (_running == 0)
        {
            ZMLR_LOG(LL_INFO, "No subscription for event notifications happened or successful");
            return DISABLE_INDICATIONS_OK;
        }
        if (_manager.unsubscribeForEventNotifications())
            ZMLR_LOG(LL_INFO, "Unsubscribtion for event notifications is successful.");
        else
        {
            ZMLR_LOG(LL_ERR, "Un-subscribtion for event notifications FAILED.");
            ZMLR_LOG(LL_INFO, "Continue to stop the thread created for listening to events");
        }
        --_running;
        ZMLR_LOG(LL_INFO, "Stopping the indication thread created.");
        void* result = nullptr;
        Thread::join(_delivery_thread, result);
        _handler->handle(nullptr); // there will be no more
        _handler.reset();
        return DISABLE_INDICATIONS_OK;
    }

private:
    bool start_delivery()
    try
    {
        const int error = Thread::create_joinable(_delivery_thread, deliverIndications, this);
        if (error != 0)
            ZMLR_LOG(LL_ERR, "Unable to create the indication thread. ret = %d", error);
        return error == 0;
    }
    catch (const std::exception& exception)
    {
        ZMLR_LOG(LL_ERR, "Unable to create the indication thread: %s", exception.what());
        return false;
    }
    catch (...) // out of the server, which prepares the thread
    {
        ZMLR_LOG(LL_ERR, "Unable to create the indication thread: %s", "unexpected exception");
        return false;
    }

    // At the end of a process that did not disable it, this thread runs on while everything static is destroyed.
    static void* deliverIndications(void* provider)
    {
        const Scope_Trace trace(log_source);
        auto& self = *static_cast<ZEMLAR_AlertIndication_Provider*>(provider);
        while (self._running != 0)
        {
            self.deliver_one();
            Time::sleep(cycle);
        }
        return nullptr;
    }

    void deliver_one()
    try
    {
        Ref<ZEMLAR_AlertIndication> alert;
        if (!_manager.getIndicationObject(alert))
            return;
        _handler->handle(clone(alert.ptr()));
        ZMLR_LOG(LL_INFO, "Delivered indication to the CIM server");
    }
    catch (const std::exception& exception)
    {
        ZMLR_LOG(LL_ERR, "An alert is lost: %s", exception.what());
    }

    const IndicationManager& _manager = IndicationManager::getIndicationManager();
    Thread _delivery_thread;
    std::atomic<uint32> _running = 0; // not 0 while there is a handler
    std::unique_ptr<Alert_Handler> _handler;
};

} // namespace

ZEMLAR_AlertIndication_Provider_Skeleton* create_ZEMLAR_AlertIndication_Provider() { return new ZEMLAR_AlertIndication_Provider; }

} // namespace zmlr
