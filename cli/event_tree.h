// One event of a driver, as it is printed: when, how urgent, what, and the message of the library's table.
#pragma once

#include "cli/value.h"
#include "hxal/aen.h"

#include <string>

namespace hxa
{

// Whom an event came from.
struct Event_Source
{
    std::string element; // "port 1/0", "adapter 2"
    int instance = -1;   // of the IOC
};

// One for each kind of data that the library's callbacks get. A number that the table does not know is told as such.
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_adapter_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_port_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_lport_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_rport_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_itnim_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_audit_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_ioc_aen_data_t& data, hxa_timeval_t time);
Value event_tree(const Event_Source& source, std::uint32_t event, const hxa_ethport_aen_data_t& data, hxa_timeval_t time);

// One line: time, severity, element, message.
std::string event_text(const Value& event);

} // namespace hxa
