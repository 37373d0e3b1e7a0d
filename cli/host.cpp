#include "cli/host.h"

#include "cli/field_text.h"
#include "text/integers.h"

#include <algorithm>

namespace hxa
{

namespace
{

[[noreturn]] void refuse(const std::string& kind, const std::string& text)
{
    throw Failure(Exit::no_such_element, "no " + kind + " \"" + safe_text(text) + "\" on this host");
}

bool is_port(const Port& port, const std::string& text)
{
    const auto wwn = read_wwn(text);
    const auto mac = read_mac(text);
    const auto has_mac = [&](const hxal_t* ioc) { return ioc && std::equal(mac->mac, mac->mac + sizeof mac->mac, ioc->mac.mac); };
    return text == port.name() || (wwn && port.fc && (port.fc->pwwn == *wwn || port.fc->nwwn == *wwn)) ||
           (mac && ((port.is_converged() && has_mac(port.fc)) || has_mac(port.ethernet)));
}

// A device's name may look like a number: a number comes first, then the serial number, which its factory gave, then the name.
const Adapter* find_adapter(const std::vector<Adapter>& adapters, const std::string& text)
{
    const auto find = [&](auto fits) { return std::find_if(adapters.begin(), adapters.end(), fits); };
    auto found = find([&](const Adapter& adapter) { return text == adapter.name(); });
    if (found == adapters.end())
        found = find([&](const Adapter& adapter) { return text == adapter.handle->serial_num; });
    if (found == adapters.end())
        found = find([&](const Adapter& adapter) { return text == adapter.handle->name; });
    return found == adapters.end() ? nullptr : &*found;
}

const Port* find_port(const std::vector<Port>& ports, const std::string& text)
{
    const auto found = std::find_if(ports.begin(), ports.end(), [&](const Port& port) { return is_port(port, text); });
    return found == ports.end() ? nullptr : &*found;
}

} // namespace

Host::Host(Session& session, hxa_aen_app_t application)
{
    hxal_libinit(application);
    hxal_set_last_error(HXA_STATUS_OK);
    const int count = hxal_adapter_scan();
    const auto status = hxal_get_last_error();
    if (count == 0 && (status == HXA_STATUS_NO_DRIVER || status == HXA_STATUS_VERSION_FAIL))
        throw Failure(Exit::no_driver, status_text(status));
    if (count == 0)
        require(status, "cannot read the adapters");
    else if (status != HXA_STATUS_NO_DRIVER)
        session.accept(status, "cannot read all adapters");
}

Host::~Host() { hxal_libexit(); }

std::vector<Adapter> Host::adapters(const std::string& text) const
{
    std::vector<Adapter> all;
    for (int number = 1; number <= static_cast<int>(hxal_adapter_get_num()); ++number)
        if (auto* handle = hxal_adapter_open_idx(number))
            all.push_back({number, handle});
    return text.empty() ? all : std::vector<Adapter>{adapter(text)};
}

Adapter Host::adapter(const std::string& text) const
{
    const auto all = adapters();
    if (const auto* found = find_adapter(all, text))
        return *found;
    const auto all_ports = ports();
    if (const auto* found = find_port(all_ports, text))
        return found->adapter;
    refuse("adapter", text);
}

std::vector<Port> Host::ports(const std::string& text) const
{
    std::vector<Port> all;
    for (const auto& adapter : adapters())
        for (const auto& port : ports_of(adapter))
            all.push_back(port);
    if (text.empty())
        return all;
    if (const auto* found = find_port(all, text))
        return {*found};
    const auto all_adapters = adapters();
    if (const auto* found = find_adapter(all_adapters, text))
        return ports_of(*found);
    refuse("adapter or port", text);
}

Port Host::port(const std::string& text) const
{
    const auto all = ports();
    if (const auto* found = find_port(all, text))
        return *found;
    refuse("port", text);
}

std::vector<Port> ports_of(const Adapter& adapter)
{
    std::vector<Port> ports;
    for (int number = 0; number < adapter.handle->port_count; ++number)
    {
        const Port port{adapter, number, hxal_adapter_get_fcioc(adapter.handle, number),
                        hxal_adapter_get_ethioc(adapter.handle, number)};
        if (port.ioc())
            ports.push_back(port);
    }
    return ports;
}

} // namespace hxa
