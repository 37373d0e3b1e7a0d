// Alerts: what an event of an adapter's port becomes for subscribers.
#pragma once

#include "hxal/aen.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_AlertIndication.h"

namespace zmlr
{

// CIM_AlertIndication.AlertType
enum Alert_Type : uint16
{
    ALERT_TYPE_OTHER = 1,
    ALERT_TYPE_COMMUNICATIONS = 2
};

// An alert with all that is told of the event in `row`, but for its message. `kind` is the kind of event ("Port"), `host` the
// host's text, `element` the path of the object it happened to.
Ref<ZEMLAR_AlertIndication> new_alert(const hxal_aen_msg_t& row, const char* kind, const String& host, const String& element);

// The message, made of a format for printf(3) with places for one or two texts and cut to 255 bytes; those texts become its
// arguments.
void set_message(ZEMLAR_AlertIndication& alert, const char* format, const String& first);
void set_message(ZEMLAR_AlertIndication& alert, const char* format, const String& first, const String& second);

} // namespace zmlr
