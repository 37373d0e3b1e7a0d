// Events as the drivers raise them, with the names and addresses of the objects they are about.
#pragma once

#include "sim/model/host.h"

#include "hxal/records/aen.h"

namespace hxasim
{

// What an event is about, beyond the function that raises it.
struct Event_Subject
{
    const Logical_Port* logical = nullptr; // null: the base port
    const Remote_Port* remote = nullptr;   // null: the first one behind the logical port, if there is any
    std::int16_t level = 0;                // hxa_pom_health_t, of optical monitoring
};

// An event of this function, as it is handed to Host::raise(). A category that the drivers do not raise has no data.
hxa_aen_entry_t make_event(const Ioc& ioc, std::uint32_t category, std::uint32_t type, const Event_Subject& subject = {});

} // namespace hxasim
