#include "indications/alert.h"

#include "indications/event_details.h"
#include "indications/severity.h"
#include "inventory/provider_util.h"
#include "runtime/log.h"

#include <cstdio>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";
constexpr std::size_t message_size = 256;

constexpr uint16 CIM_OBJECT_PATH = 2;      // CIM_AlertIndication.AlertingElementFormat
constexpr uint16 PROBABLE_CAUSE_OTHER = 1; // CIM_AlertIndication.ProbableCause

String filled(const char* format, const String& first, const String& second)
{
    char text[message_size];
    std::snprintf(text, sizeof text, format, first.c_str(), second.c_str());
    return text;
}

} // namespace

Ref<ZEMLAR_AlertIndication> new_alert(const hxal_aen_msg_t& row, const char* kind, const String& host, const String& element)
{
    const auto id = static_cast<uint32>(row.id);
    const Datetime now = Datetime::now();
    const String cause = getEventCauseById(id);

    Ref<ZEMLAR_AlertIndication> alert(ZEMLAR_AlertIndication::create());
    alert->AlertingManagedElement.set(element);
    alert->AlertingElementFormat.set(CIM_OBJECT_PATH);
    alert->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    alert->SystemName.set(host);
    alert->ProviderName.set("zmlrprovider");
    alert->EventTime.set(now);
    alert->IndicationTime.set(now);
    alert->OwningEntity.set("ZEMLAR");
    alert->AlertType.set(ALERT_TYPE_OTHER);
    alert->OtherAlertType.set(kind);
    alert->Category.set(kind);
    alert->ProbableCause.set(PROBABLE_CAUSE_OTHER);
    ZMLR_LOG(LL_INFO, "Generated Event is : %s", row.name);
    alert->IndicationIdentifier.set(row.name);
    alert->EventID.set(row.name);
    alert->PerceivedSeverity.set(getPerceivedSeverity(row.severity));
    alert->Description.set(cause);
    alert->ProbableCauseDescription.set(cause);
    alert->RecommendedActions.set({getEventActionById(id)});
    alert->MessageID.set(getMessageIDById(id));
    ZMLR_LOG(LL_INFO, "Message ID = %s", alert->MessageID.value.c_str());
    return alert;
}

void set_message(ZEMLAR_AlertIndication& alert, const char* format, const String& first)
{
    alert.Message.set(filled(format, first, String()));
    alert.MessageArguments.set({first});
}

void set_message(ZEMLAR_AlertIndication& alert, const char* format, const String& first, const String& second)
{
    alert.Message.set(filled(format, first, second));
    alert.MessageArguments.set({first, second});
}

} // namespace zmlr
