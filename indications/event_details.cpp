#include "indications/event_details.h"

#include "hxal/records/aen.h"
#include "indications/event_index.h"
#include "runtime/trace.h"

#include <algorithm>
#include <iterator>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

struct Event_Details
{
    uint32 id;
    const char* message_id;
    const char* cause;
    const char* action;
};

constexpr uint32 port(hxa_port_aen_event_t event) { return event_id(HXA_AEN_CAT_PORT, event); }
constexpr uint32 ethernet(hxa_ethport_aen_event_t event) { return event_id(HXA_AEN_CAT_ETHPORT, event); }
constexpr uint32 audit(hxa_audit_aen_event_t event) { return event_id(HXA_AEN_CAT_AUDIT, event); }

constexpr const char* nothing = "No action required.";

// Enabling and disabling an Ethernet interface are told with the messages of DMTF's platform registry (DSP8007).
// clang-format off
constexpr Event_Details details[] = {
    {port(HXA_PORT_AEN_ONLINE),             "ZMLR131073", "Base port logged into Fabric.", nothing},
    {port(HXA_PORT_AEN_OFFLINE),            "ZMLR131074", "Base port logged out of Fabric.", nothing},
    {port(HXA_PORT_AEN_RLIR),               "ZMLR131075", "", "No action required. Not supported"},
    {port(HXA_PORT_AEN_SFP_INSERT),         "ZMLR131076", "User plugged in a SFP.", nothing},
    {port(HXA_PORT_AEN_SFP_REMOVE),         "ZMLR131077", "SFP removed.", "Check whether SFP is inserted properly."},
    {port(HXA_PORT_AEN_SFP_POM),            "ZMLR131078",
     "A POM is a Pluggable Optical Module inserted into a Small Form-Factor Pluggable (SFP) socket. Event is triggered if there is "
     "a change of current value against threshold of operational characteristics (temperature, voltage and rx/tx power) of SFP.",
     "If POM level is not normal please check the SFP."},
    {port(HXA_PORT_AEN_ENABLE),             "ZMLR131079", "Base port enabled by user command.", nothing},
    {port(HXA_PORT_AEN_DISABLE),            "ZMLR131080", "Base port disabled by user command.", nothing},
    {port(HXA_PORT_AEN_AUTH_ON),            "ZMLR131081", "Authentication successful.", nothing},
    {port(HXA_PORT_AEN_AUTH_OFF),           "ZMLR131082", "Authentication failure.",
     "Mismatch of FC-SP configuration between switch and HBA. Also, check the secret."},
    {port(HXA_PORT_AEN_DISCONNECT),         "ZMLR131083", "Base port lost connection with fabric.",
     "Check switch and HBA configuration. Also, check SFP and cable connection."},
    {port(HXA_PORT_AEN_QOS_NEG),            "ZMLR131084", "QOS negotiation failed.", "Check switch and HBA configuration."},
    {port(HXA_PORT_AEN_FABRIC_NAME_CHANGE), "ZMLR131085", "Fabric WWN changed.", "Check switch and HBA configuration."},
    {port(HXA_PORT_AEN_SFP_ACCESS_ERROR),   "ZMLR131086", "Can not read SFP registers.", "Recommend to replace the SFP."},
    {port(HXA_PORT_AEN_SFP_UNSUPPORT),      "ZMLR131087", "SFP is not supported.", "Recommend to use supported SFP."},
    {ethernet(HXA_ETHPORT_AEN_LINKUP),      "ZMLR655361", "Base port ethernet link is up.", nothing},
    {ethernet(HXA_ETHPORT_AEN_LINKDOWN),    "ZMLR655362", "Base port ethernet link is down.", nothing},
    {ethernet(HXA_ETHPORT_AEN_ENABLE),      "PLAT260",    "Base port ethernet interface is enabled.", nothing},
    {ethernet(HXA_ETHPORT_AEN_DISABLE),     "PLAT261",    "Base port ethernet interface is disabled.", nothing},
    {audit(HXA_AUDIT_AEN_AUTH_ENABLE),      "ZMLR524289", "Authentication enabled by user command.", nothing},
    {audit(HXA_AUDIT_AEN_AUTH_DISABLE),     "ZMLR524290", "Authentication disabled by user command.", nothing},
};
// clang-format on

const char* text_of(uint32 id, const char* Event_Details::*column)
{
    const auto* row = std::ranges::find(details, id, &Event_Details::id);
    return row == std::end(details) ? "Unknown" : row->*column;
}

} // namespace

const char* getEventCauseById(uint32 id)
{
    const Scope_Trace trace(log_source);
    return text_of(id, &Event_Details::cause);
}

const char* getEventActionById(uint32 id)
{
    const Scope_Trace trace(log_source);
    return text_of(id, &Event_Details::action);
}

const char* getMessageIDById(uint32 id)
{
    const Scope_Trace trace(log_source);
    return text_of(id, &Event_Details::message_id);
}

} // namespace zmlr
