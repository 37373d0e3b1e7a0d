// The beacon of an FC port: switching it.
#pragma once

#include "runtime/string.h"

namespace zmlr
{

enum Beacon_Result : int
{
    BEACON_FAILED = 0,
    BEACON_DONE = 1,
    BEACON_NOT_SUPPORTED = 2, // on a mezzanine card
    BEACON_ALREADY_SO = 3
};

// Turns on the beacon of the FC port with this WWN, until it is turned off, when `state` is 3 (CIM_AlarmDevice.AlarmState:
// Alternating), and off for every other state. Reads the card's attributes and the port's before it switches (a request each); a
// card whose attributes cannot be read is left alone.
Beacon_Result setAlarmState(const String& port_wwn, int state);

} // namespace zmlr
