#include "cli/host.h"

#include "cli/field_text.h"
#include "text/integers.h"

#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <iterator>
#include <optional>

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

// The only element that fits. Cards may have one serial number, and ports one node WWN: then nobody knows which one was meant.
template <typename Element, typename Fits>
const Element* find_only(const std::vector<Element>& elements, const std::string& text, const Fits& fits)
{
    const auto found = std::find_if(elements.begin(), elements.end(), fits);
    if (found == elements.end())
        return nullptr;
    const auto other = std::find_if(found + 1, elements.end(), fits);
    if (other != elements.end())
        throw Failure(Exit::no_such_element,
                      '"' + safe_text(text) + "\" names " + found->name() + " as well as " + other->name());
    return &*found;
}

// A device's name may look like a number: a number comes first, then the serial number, which its factory gave, then the name.
const Adapter* find_adapter(const std::vector<Adapter>& adapters, const std::string& text)
{
    const auto find = [&](const auto& fits) { return find_only(adapters, text, fits); };
    const auto* found = find([&](const Adapter& adapter) { return text == adapter.name(); });
    if (!found)
        found = find([&](const Adapter& adapter) { return text == adapter.handle->serial_num; });
    return found ? found : find([&](const Adapter& adapter) { return text == adapter.handle->name; });
}

std::vector<Port> find_ports(const std::vector<Port>& ports, const std::string& text)
{
    std::vector<Port> found;
    std::copy_if(ports.begin(), ports.end(), std::back_inserter(found), [&](const Port& port) { return is_port(port, text); });
    return found;
}

// A driver that is there and that the caller may not ask looks to the library like none.
std::optional<std::string> obstacle()
{
    for (const std::string node : {"/dev/hxa", "/dev/hxn"})
        if (access(node.c_str(), R_OK | W_OK) != 0 && errno != ENOENT)
            return node + ": " + std::strerror(errno);
    return std::nullopt;
}

} // namespace

Host::Host(Session& session, hxa_aen_app_t application)
{
    hxal_libinit(application);
    hxal_set_last_error(HXA_STATUS_OK);
    const int count = hxal_adapter_scan();
    const auto status = hxal_get_last_error();
    if (count == 0 && (status == HXA_STATUS_NO_DRIVER || status == HXA_STATUS_VERSION_FAIL))
        throw Failure(Exit::no_driver, obstacle().value_or(status_text(status)));
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
    const auto found = find_ports(ports(), text);
    if (found.empty())
        refuse("adapter", text);
    return found.front().adapter;
}

std::vector<Port> Host::ports(const std::string& text) const
{
    std::vector<Port> all;
    for (const auto& adapter : adapters())
        for (const auto& port : ports_of(adapter))
            all.push_back(port);
    if (text.empty())
        return all;
    if (auto found = find_ports(all, text); !found.empty())
        return found;
    const auto all_adapters = adapters();
    if (const auto* found = find_adapter(all_adapters, text))
        return ports_of(*found);
    refuse("adapter or port", text);
}

Port Host::port(const std::string& text) const
{
    const auto all = ports();
    if (const auto* found = find_only(all, text, [&](const Port& port) { return is_port(port, text); }))
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
