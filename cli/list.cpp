#include "cli/commands.h"
#include "cli/report.h"
#include "cli/trees.h"

namespace hxa
{

namespace
{

// clang-format off
constexpr Column adapter_columns[] = {
    {"Adapter",  "adapter"},
    {"Model",    "model"},
    {"Serial",   "serial_number"},
    {"Name",     "name"},
    {"Firmware", "firmware_version"},
    {"Speed",    "max_speed_gbps", " Gbit/s"},
    {"Path",     "hardware_path"},
};

constexpr Column port_columns[] = {
    {"Port",      "port"},
    {"Type",      "type"},
    {"Port WWN",  "fc.wwn"},
    {"Node WWN",  "fc.node_wwn"},
    {"FC state",  "fc.state"},
    {"Speed",     "fc.speed_gbps", " Gbit/s"},
    {"Interface", "ethernet.interface"},
    {"MAC",       "ethernet.mac"},
    {"Eth state", "ethernet.state"},
    {"Name",      "name"},
};

constexpr Column ioc_columns[] = {
    {"Port",     "port"},
    {"Type",     "ioc.type"},
    {"Device",   "ioc.device"},
    {"Instance", "ioc.instance"},
    {"Path",     "ioc.hardware_path"},
    {"State",    "ioc.state"},
    {"Driver",   "ioc.driver"},
    {"Version",  "ioc.driver_version"},
};
// clang-format on

std::string names(const Host& host)
{
    std::string text;
    for (const auto& adapter : host.adapters())
    {
        text += adapter.name() + '\n';
        for (const auto& port : ports_of(adapter))
            text += port.name() + '\n';
    }
    return text;
}

} // namespace

void list(Session& session, const List_Options& options)
{
    const Host host;
    if (options.names)
        return session.print(names(host));
    List adapters, ports, iocs;
    for (const auto& adapter : host.adapters(options.adapter))
    {
        adapters.push_back(adapter_tree(session, adapter));
        for (const auto& port : adapters.back().at("ports").list())
        {
            ports.push_back(port);
            for (const char* function : {"fc.ioc", "ethernet.ioc"})
                if (!port.at(function).is_null())
                    iocs.push_back(Object{{"port", port.at("port")}, {"ioc", port.at(function)}});
        }
    }
    session.answer(Object{{"adapters", adapters}},
                   table(adapters, adapter_columns) + '\n' + table(ports, port_columns) + '\n' + table(iocs, ioc_columns));
}

} // namespace hxa
