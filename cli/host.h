// The adapters and ports of this host, and the names by which a person selects them.
#pragma once

#include "cli/session.h"
#include "hxal/adapter.h"

#include <string>
#include <vector>

namespace hxa
{

struct Adapter
{
    int number; // from 1
    hxal_adapter_t* handle;

    std::string name() const { return std::to_string(number); }
    hxal_t* ioc() const { return hxal_adapter_get_first_ioc(handle); }
};

// A port of a card, with its IOCs: an FC port has the first, a converged port both.
struct Port
{
    Adapter adapter;
    int number; // from 0
    hxal_t* fc;
    hxal_t* ethernet;

    std::string name() const { return adapter.name() + '/' + std::to_string(number); }
    hxal_t* ioc() const { return fc ? fc : ethernet; }
    bool is_converged() const { return fc && fc->ioc_type == HXA_IOC_TYPE_FCoE; }
};

// Starts the library under the identity that the drivers queue events for, and scans the host. Throws when there is no driver,
// when it refuses the library and when the scan fails otherwise; drivers that serve nothing are a host without adapters. When one
// of the two drivers fails the session tells that; one that is not there is no failure, since a host may have no use for it.
class Host
{
public:
    explicit Host(Session& session, hxa_aen_app_t application = hxa_aen_app_tessik);
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;
    ~Host();

    // What a text selects: an adapter by its number, serial number, name or a port of it; a port as "ADAPTER/PORT", by its port
    // or node WWN or its MAC. Throws when there is none, and when one is meant and there are several.
    Adapter adapter(const std::string& text) const;
    Port port(const std::string& text) const;

    // All, or those that a text selects; an adapter selects all its ports.
    std::vector<Adapter> adapters(const std::string& text = {}) const;
    std::vector<Port> ports(const std::string& text = {}) const;
};

std::vector<Port> ports_of(const Adapter& adapter);

} // namespace hxa
