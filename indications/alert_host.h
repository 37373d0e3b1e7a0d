// The host's text for alerts: looked up once for an alert, by a name service that may take its time.
#pragma once

#include "inventory/host_text.h"

#include <chrono>

namespace zmlr
{

// Events wait while their thread looks the host up. So that none waits longer than one look-up takes, however many are queued,
// what was found serves all alerts for some time, which is a multiple of what the look-up took: next to nothing where names are
// found in a file, some time where a name server does not answer, but never longer than half a minute: then a name that was
// found without its server gives way. Ending the events' thread, and so disabling, can wait for one look-up. For one thread.
class Alert_Host
{
public:
    String text();

private:
    using Clock = std::chrono::steady_clock;
    static constexpr int holds = 9; // times as long as the look-up took: a tenth of the thread's time is spent with it
    static constexpr std::chrono::seconds longest_hold{30}; // with a look-up of 10 s: a quarter

    Host_Text _host;
    Clock::time_point _good_until = {};
};

} // namespace zmlr
