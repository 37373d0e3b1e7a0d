#include "elements.h"
#include "providers/TST_Alert_Provider_Skeleton.h"

#include <memory>

namespace zmlr
{

namespace
{

// Alerts are raised by another provider's requests, on their threads.
std::mutex handler_mutex;
std::unique_ptr<Indication_Handler<TST_Alert>> enabled_handler;

class TST_Alert_Provider final : public TST_Alert_Provider_Skeleton
{
public:
    Enable_Indications_Status enable_indications(Indication_Handler<TST_Alert>* handler) override
    {
        const std::lock_guard lock(handler_mutex);
        enabled_handler.reset(handler);
        return ENABLE_INDICATIONS_OK;
    }

    Disable_Indications_Status disable_indications() override
    {
        const std::lock_guard lock(handler_mutex);
        enabled_handler.reset();
        return DISABLE_INDICATIONS_OK;
    }
};

} // namespace

// The handler is copied: delivery takes locks that a disable may hold.
bool raise_alert(uint32 number, const String& text)
{
    std::unique_ptr<Indication_Handler<TST_Alert>> handler;
    {
        const std::lock_guard lock(handler_mutex);
        if (!enabled_handler)
            return false;
        handler = std::make_unique<Indication_Handler<TST_Alert>>(*enabled_handler);
    }
    TST_Alert* alert = TST_Alert::create();
    alert->Number.set(number);
    alert->Text.set(text);
    return handler->handle(alert);
}

TST_Alert_Provider_Skeleton* create_TST_Alert_Provider() { return new TST_Alert_Provider; }

} // namespace zmlr
