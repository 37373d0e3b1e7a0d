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
    const Host host(session);
    if (options.names)
        return session.print(names(host));
    List adapters, ports, iocs;
    for (const auto& adapter : host.adapters(options.adapter))
    {
        List of_adapter;
        for (const auto& port : ports_of(adapter))
        {
            const auto tree = port_tree(session, port);
            of_adapter.push_back(tree);
            for (const char* function : {"fc.ioc", "ethernet.ioc"})
                if (!tree.at(function).is_null())
                    iocs.push_back(Object{{"port", tree.at("port")}, {"ioc", tree.at(function)}});
        }
        ports.insert(ports.end(), of_adapter.begin(), of_adapter.end());
        auto tree = adapter_tree(session, adapter);
        tree.push_back({"ports", of_adapter});
        adapters.push_back(tree);
    }
    session.answer(Object{{"adapters", adapters}},
                   table(adapters, adapter_columns) + '\n' + table(ports, port_columns) + '\n' + table(iocs, ioc_columns));
}

} // namespace hxa
