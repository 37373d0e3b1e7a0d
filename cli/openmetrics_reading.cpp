#include "cli/openmetrics_reading.h"

#include "cli/field_text.h"
#include "hxal/hxal.h"
#include "metrics/families.h"

#include <algorithm>
#include <cstring>

namespace hxa::openmetrics
{

namespace
{

constexpr std::uint64_t bytes_per_gigabit = 1'000'000'000 / 8;

// The text of a field; one that fills it loses its last character, as in a field with a terminator.
template <class Char, std::size_t N> std::string text_in(const Char (&field)[N])
{
    const char* const begin = reinterpret_cast<const char*>(field);
    return {begin, strnlen(begin, N - 1)};
}

// The text of a field that may be padded with blanks on both sides.
std::string trimmed(std::string text)
{
    text.erase(0, std::min(text.find_first_not_of(' '), text.size()));
    text.erase(text.find_last_not_of(' ') + 1);
    return text;
}

template <std::size_t N> std::string padded(const std::uint8_t (&field)[N])
{
    const char* const begin = reinterpret_cast<const char*>(field);
    return trimmed({begin, strnlen(begin, N)});
}

// By which CIM knows the card too: an FC HBA's node WWN, a converged card's MAC. Empty when there is none.
std::string address_of(const Adapter& adapter, bool is_cna)
{
    const hxal_t* const fc = hxal_adapter_get_fcioc(adapter.handle, 0);
    const hxal_t* const ethernet = hxal_adapter_get_ethioc(adapter.handle, 0);
    if (!is_cna)
        return fc ? wwn_text(fc->nwwn) : std::string();
    hxa_ioctl_ioc_info_t info = {};
    if (fc && hxal_ioc_get_info(fc, &info) == HXA_STATUS_OK)
        return mac_text(info.mac);
    return fc || ethernet ? mac_text((fc ? fc : ethernet)->mac) : std::string();
}

// What the label `adapter` says: the serial number, and where several cards of the host have it, the address too.
std::string label_of(const Adapter& adapter, const std::vector<Adapter>& all, bool is_cna)
{
    const std::string serial = adapter.handle->serial_num;
    if (std::ranges::count_if(all, [&](const Adapter& other) { return serial == other.handle->serial_num; }) == 1)
        return serial;
    const std::string address = address_of(adapter, is_cna);
    return serial.empty() || address.empty() ? serial + address : serial + '_' + address;
}

class Reading
{
public:
    explicit Reading(Session& session) : _session(session) {}

    void read_adapter(const Adapter& adapter, const std::vector<Adapter>& all);

    std::uint64_t errors = 0;
    std::vector<Sample> samples;

private:
    using Labels = std::vector<std::string>;

    void add(std::string_view family, std::uint64_t value, Labels labels)
    {
        samples.push_back({family, value, std::move(labels)});
    }
    void add_info(std::string_view family, Labels labels, std::initializer_list<std::string> more);
    std::string_view add_state(std::string_view family, const Labels& labels, std::uint32_t number);
    bool succeeds(hxa_status_t status, const std::string& what);
    void read_card(const Adapter& adapter, bool is_cna);
    void read_fc(const Port& port);
    void read_module(const Port& port, const Labels& labels);
    void read_counters(const Port& port, const Labels& labels);
    void read_ethernet(const Port& port);

    Session& _session;
    std::string _adapter; // the label of the one that is read
};

void Reading::add_info(std::string_view family, Labels labels, std::initializer_list<std::string> more)
{
    labels.insert(labels.end(), more);
    add(family, 1, std::move(labels));
}

bool Reading::succeeds(hxa_status_t status, const std::string& what)
{
    errors += status != HXA_STATUS_OK;
    return _session.accept(status, what);
}

// Returns the word of the state.
std::string_view Reading::add_state(std::string_view family, const Labels& labels, std::uint32_t number)
{
    const auto has_it = [&](const Port_State& state) { return number != 0 && std::ranges::count(state.numbers, number) != 0; };
    const auto* const found = std::ranges::find_if(port_states, has_it);
    const auto* const current = found == std::end(port_states) ? std::end(port_states) - 1 : found;
    for (const Port_State& state : port_states)
    {
        Labels with_state = labels;
        with_state.emplace_back(state.word);
        add(family, &state == current, std::move(with_state));
    }
    return current->word;
}

void Reading::read_card(const Adapter& adapter, bool is_cna)
{
    hxa_ioc_attr_t attributes = {};
    for (const hxal_t* ioc : {hxal_adapter_get_ethioc(adapter.handle, 0), hxal_adapter_get_fcioc(adapter.handle, 0)})
    {
        if (!ioc || !succeeds(hxal_ioc_get_attr(ioc, &attributes), "adapter " + adapter.name()))
            continue;
        add_info("hxa_adapter_info", {_adapter, is_cna ? "CNA" : "FC HBA"},
                 {text_in(attributes.adapter_attr.model), trimmed(text_in(attributes.driver_attr.fw_ver))});
        break;
    }
    add("hxa_adapter_enabled", hxal_adapter_is_disabled(adapter.number) == HXA_FALSE, {_adapter});
}

void Reading::read_module(const Port& port, const Labels& labels)
{
    sfp_mem_t memory = {};
    const hxa_status_t status = hxal_diag_sfp_query(port.ethernet ? port.ethernet : port.fc, &memory);
    if (status != HXA_STATUS_NO_SFP_DEV && !succeeds(status, "module of port " + port.name()))
        return;
    add("hxa_port_module_present", status == HXA_STATUS_OK, labels);
    const sfp_serial_id_base_t& base = memory.serial_id_base;
    if (status == HXA_STATUS_OK)
        add_info(
            "hxa_port_module_info", labels,
            {padded(base.vendor_name), padded(base.vendor_pn), padded(memory.serial_id_ext.vendor_sn), padded(base.vendor_rev)});
}

void Reading::read_counters(const Port& port, const Labels& labels)
{
    hxal_stats_long_t counters[std::max<int>(HXAL_FC_PORT_STATS, HXAL_ETH_PORT_STATS)] = {};
    if (!succeeds(hxal_port_get_stats(port.fc, counters), "counters of port " + port.name()))
        return;
    for (const Family& family : families)
    {
        const Counted& counted = port.fc->ioc_type == HXA_IOC_TYPE_FC ? family.of_fc : family.of_fcoe;
        std::uint64_t sum = 0;
        for (const hxal_stats_long_t& counter : counters)
            sum += counter.name[0] && std::ranges::count(counted.names, counter.name) ? counter.value : 0;
        if (counted.factor != 0)
            add(family.name, sum * counted.factor, labels);
    }
}

void Reading::read_fc(const Port& port)
{
    hxa_pport_attr_t attributes = {};
    if (!succeeds(hxal_port_get_attr(port.fc, &attributes), "port " + port.name()))
        return;
    const Labels labels = {_adapter, wwn_text(attributes.pwwn)};
    add_info("hxa_port_info", labels, {wwn_text(attributes.nwwn), std::to_string(port.number), text_in(attributes.port_symname)});
    const std::string_view state = add_state("hxa_port_state", labels, attributes.port_state);
    add("hxa_port_speed_bytes_per_second", attributes.speed * bytes_per_gigabit, labels);
    add("hxa_port_max_speed_bytes_per_second", attributes.speed_supported * bytes_per_gigabit, labels);
    if (state != "error" && state != "unknown") // else the controller may be out of service, and nobody knows of the module
        read_module(port, labels);
    read_counters(port, labels);
}

void Reading::read_ethernet(const Port& port)
{
    hxa_ethport_attr_t attributes = {};
    if (!succeeds(hxal_ethport_get_attr(port.ethernet, &attributes), "Ethernet port " + port.name()))
        return;
    const Labels labels = {_adapter, mac_text(port.ethernet->mac)};
    add_info("hxa_ethernet_port_info", labels, {std::to_string(port.number), port.ethernet->eth_name});
    add_state("hxa_ethernet_port_state", labels, attributes.port_state);
    add("hxa_ethernet_port_speed_bytes_per_second", attributes.speed * bytes_per_gigabit, labels);
}

// Ethernet functions of a card that is no converged one are nobody's, as over CIM.
void Reading::read_adapter(const Adapter& adapter, const std::vector<Adapter>& all)
{
    const bool is_cna = hxal_adapter_is_cna_capable(adapter.number) != HXA_FALSE;
    _adapter = label_of(adapter, all, is_cna);
    read_card(adapter, is_cna);
    for (Port port : ports_of(adapter))
    {
        port.ethernet = is_cna ? port.ethernet : nullptr;
        if (port.fc)
            read_fc(port);
        if (port.ethernet)
            read_ethernet(port);
    }
}

} // namespace

std::vector<Sample> read_samples(Session& session, const Host& host, std::time_t now)
{
    Reading reading(session);
    const auto adapters = host.adapters();
    for (const Adapter& adapter : adapters)
        reading.read_adapter(adapter, adapters);
    reading.samples.push_back({"hxa_adapters", adapters.size()});
    reading.samples.push_back({"hxa_last_read_timestamp_seconds", static_cast<std::uint64_t>(now)});
    reading.samples.push_back({"hxa_read_errors", reading.errors});
    return reading.samples;
}

} // namespace hxa::openmetrics
