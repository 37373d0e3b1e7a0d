#include "cli/event_tree.h"

#include "cli/field_text.h"
#include "cli/report.h"
#include "hxal/records/lport.h"
#include "hxal/value_names.h"

#include <algorithm>
#include <ctime>
#include <vector>

namespace hxa
{

namespace
{

using Texts = std::vector<std::string>;

const hxal_aen_msg_t* message_of(hxa_aen_category_t category, std::uint32_t event)
{
    for (const auto* row = hxal_aen_msg_array; row->id != 0; ++row)
        if (static_cast<std::uint32_t>(row->id) == (static_cast<std::uint32_t>(category) << 16 | event))
            return row;
    return nullptr;
}

// The message with the texts in the places that printf(3) would fill; "?" where there are not enough of them.
std::string filled(std::string_view format, const Texts& texts)
{
    std::string message;
    auto next = texts.begin();
    for (std::size_t i = 0; i < format.size(); ++i)
        if (format[i] != '%')
            message += format[i];
        else
        {
            message += next == texts.end() ? "?" : *next++;
            ++i;
        }
    return message;
}

// ISO 8601, UTC.
std::string time_text(hxa_timeval_t time)
{
    const std::time_t seconds = time.tv_sec;
    std::tm fields{};
    gmtime_r(&seconds, &fields);
    char text[64];
    const auto size = std::strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%S.", &fields);
    std::snprintf(text + size, sizeof text - size, "%06uZ", time.tv_usec % 1000000);
    return text;
}

Value event(const Event_Source& source, hxa_aen_category_t category, const char* category_word, std::uint32_t number,
            hxa_timeval_t time, const Texts& texts, Object names)
{
    const auto* row = message_of(category, number);
    Object tree{{"time", time_text(time)},
                {"severity", row ? hxal_log_severity_to_string(static_cast<std::uint32_t>(row->severity)) : "unknown"},
                {"element", source.element},
                {"category", category_word},
                {"number", number},
                {"event", row ? row->name : "unknown"},
                {"message", row ? filled(row->format, texts) : std::string(category_word) + " event " + std::to_string(number)}};
    for (auto& member : names)
        tree.push_back(std::move(member));
    return tree;
}

bool has_mac(const mac_t& mac)
{
    return std::any_of(std::begin(mac.mac), std::end(mac.mac), [](std::uint8_t byte) { return byte != 0; });
}

// Optical monitoring tells its events' level in numbers of their own: those of a module's health count from 2.
std::string level_text(int level)
{
    constexpr const char* levels[] = {"unknown", "normal", "warning", "alarm"};
    return levels[level >= 1 && level <= 3 ? level : 0];
}

std::string role_text(int roles)
{
    std::string text;
    for (const auto& [role, word] :
         {std::pair{HXA_PORT_ROLE_FCP_IM, "initiator"}, {HXA_PORT_ROLE_FCP_TM, "target"}, {HXA_PORT_ROLE_FCP_IPFC, "IP"}})
        if (roles & role)
            text += (text.empty() ? "" : "+") + std::string(word);
    return text.empty() ? "none" : text;
}

} // namespace

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_adapter_aen_data_t& data, hxa_timeval_t time)
{
    const auto serial = field_text(data.serial_num), wwn = wwn_text(data.pwwn);
    return event(source, HXA_AEN_CAT_ADAPTER, "adapter", number, time, {serial, wwn}, {{"serial_number", serial}, {"wwn", wwn}});
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_port_aen_data_t& data, hxa_timeval_t time)
{
    const bool by_mac = data.pwwn == 0 && has_mac(data.mac);
    const auto name = by_mac ? mac_text(data.mac) : wwn_text(data.pwwn), fabric = wwn_text(data.fwwn),
               level = level_text(data.level);
    const bool is_monitoring = number == HXA_PORT_AEN_SFP_POM;
    Object names{{by_mac ? "mac" : "wwn", name}};
    if (is_monitoring)
        names.push_back({"level", level});
    if (number == HXA_PORT_AEN_FABRIC_NAME_CHANGE)
        names.push_back({"fabric_wwn", fabric});
    return event(source, HXA_AEN_CAT_PORT, "port", number, time, is_monitoring ? Texts{level, name} : Texts{name, fabric},
                 std::move(names));
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_lport_aen_data_t& data, hxa_timeval_t time)
{
    const auto wwn = wwn_text(data.lpwwn), role = role_text(data.roles);
    return event(source, HXA_AEN_CAT_LPORT, "logical port", number, time, {wwn, role},
                 {{"logical_port", wwn}, {"role", role}, {"virtual_fabric", unsigned{data.vf_id}}});
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_rport_aen_data_t& data, hxa_timeval_t time)
{
    const auto logical = wwn_text(data.lpwwn), remote = wwn_text(data.rpwwn);
    const std::string priority = hxal_qos_priority_to_string(data.priv.qos_priority);
    Texts texts{remote, logical};
    if (number == HXA_RPORT_AEN_QOS_PRIO)
        texts.insert(texts.begin(), priority);
    if (number == HXA_RPORT_AEN_QOS_FLOWID)
        texts.insert(texts.begin(), std::to_string(data.priv.qos_flow_id));
    return event(source, HXA_AEN_CAT_RPORT, "remote port", number, time, texts,
                 {{"logical_port", logical}, {"remote_port", remote}, {"virtual_fabric", unsigned{data.vf_id}}});
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_itnim_aen_data_t& data, hxa_timeval_t time)
{
    const auto logical = wwn_text(data.lpwwn), remote = wwn_text(data.rpwwn);
    return event(source, HXA_AEN_CAT_ITNIM, "target", number, time, {remote, logical},
                 {{"logical_port", logical}, {"remote_port", remote}, {"virtual_fabric", unsigned{data.vf_id}}});
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_audit_aen_data_t& data, hxa_timeval_t time)
{
    const auto wwn = wwn_text(data.pwwn);
    return event(source, HXA_AEN_CAT_AUDIT, "audit", number, time, {wwn}, {{"wwn", wwn}});
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_ioc_aen_data_t& data, hxa_timeval_t time)
{
    const bool is_fc = data.ioc_type != HXA_IOC_TYPE_LL;
    return event(source, HXA_AEN_CAT_IOC, "ioc", number, time, {std::to_string(source.instance)},
                 {{"instance", source.instance}, {is_fc ? "wwn" : "mac", is_fc ? wwn_text(data.pwwn) : mac_text(data.mac)}});
}

Value event_tree(const Event_Source& source, std::uint32_t number, const hxa_ethport_aen_data_t& data, hxa_timeval_t time)
{
    const auto mac = mac_text(data.mac);
    const std::string state = hxal_ethport_cee_state_to_string(data.cee_state);
    return event(source, HXA_AEN_CAT_ETHPORT, "ethernet port", number, time, {mac, state}, {{"mac", mac}, {"cee_state", state}});
}

std::string event_text(const Value& event)
{
    auto severity = cell(event.at("severity"));
    severity.resize(std::max<std::size_t>(severity.size(), 8), ' ');
    return cell(event.at("time")) + "  " + severity + "  " + cell(event.at("element")) + "  " + cell(event.at("message")) + '\n';
}

} // namespace hxa
