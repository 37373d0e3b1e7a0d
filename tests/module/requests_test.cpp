// What requests answer on simulated adapters, and which driver requests they cost.

#include "cimserver/operations/provider_call.h"
#include "tests/module/loaded_module.h"

#include <algorithm>
#include <map>

using testing::AllOf;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{

class Requests : public Loaded_Module
{
protected:
    static std::vector<std::string> device_ids(const std::vector<cimserver::Instance>& instances)
    {
        std::vector<std::string> ids;
        for (const auto& instance : instances)
            ids.push_back(instance.properties.find("DeviceID")->get<cimserver::Text>());
        return ids;
    }
};

} // namespace

TEST_F(Requests, ports_cost_one_request_each)
{
    load("fc-hba");
    commands();

    EXPECT_THAT(device_ids(enumerate("ZEMLAR_FCPort")), ElementsAre("100000051E123456", "100000051E123457"));
    EXPECT_THAT(commands(), ElementsAre("IOCMD_PORT_GET_ATTR", "IOCMD_PORT_GET_ATTR"));

    EXPECT_THAT(operations().enumerate_instance_names("ZEMLAR_FCPort"), SizeIs(2));
    EXPECT_THAT(commands(), SizeIs(2));

    EXPECT_THAT(enumerate("ZEMLAR_ComputerSystem"), SizeIs(1));
    EXPECT_THAT(commands(), IsEmpty()) << "the host is described without asking a driver";
}

TEST_F(Requests, the_largest_host)
{
    load("large");
    commands();
    const auto ids = device_ids(enumerate("ZEMLAR_FCPort"));
    EXPECT_THAT(ids, SizeIs(128));
    EXPECT_THAT(commands(), AllOf(SizeIs(128), Each("IOCMD_PORT_GET_ATTR")));
    auto sorted = ids;
    std::sort(sorted.begin(), sorted.end());
    EXPECT_EQ(std::adjacent_find(sorted.begin(), sorted.end()), sorted.end());
}

// Servers may pass any path on.
TEST_F(Requests, an_enumeration_is_whole_whatever_keys_its_path_has)
{
    load("mixed");
    const cimserver::Object_Path port = enumerate("ZEMLAR_FCPort").at(3).path;
    const cimserver::Class_Entry& provider = *module().repository().find("ZEMLAR_FCPort");
    CMPIInstanceMI* mi = module().instance_mi(provider);
    cimserver::Path_Sink names(name_space);
    cimserver::Provider_Call(module(), provider, "", port, names).run(mi, mi->ft->enumerateInstanceNames);
    EXPECT_THAT(names.found, SizeIs(8));
    cimserver::Instance_Sink instances(name_space, std::nullopt);
    cimserver::Provider_Call(module(), provider, "", port, instances).run(mi, mi->ft->enumerateInstances, nullptr);
    EXPECT_THAT(instances.found, SizeIs(8));

    requests();
    operations().get_instance(port, std::nullopt);
    EXPECT_THAT(requests(), SizeIs(1)) << "that of the one port";
}

TEST_F(Requests, every_class_answers_on_every_host)
{
    const struct
    {
        const char* scenario;
        std::size_t adapters;
        std::size_t ports;
    } hosts[] = {{"fc-hba", 1, 2},   {"cna", 1, 2},       {"mixed", 4, 8},
                 {"large", 64, 128}, {"no-driver", 0, 0}, {"version-refused", 0, 0}};
    for (const auto& host : hosts)
    {
        load(host.scenario);
        const std::map<std::string, std::size_t> expected = {
            {"ZEMLAR_ComputerSystem", 1}, {"ZEMLAR_PortController", host.adapters}, {"ZEMLAR_FCPort", host.ports}};
        for (const auto* meta_class : operations().enumerate_classes("", true))
        {
            const std::string name = meta_class->name;
            if (!name.starts_with("ZEMLAR_"))
                continue;
            const std::size_t count = enumerate(name).size();
            if (expected.contains(name))
            {
                EXPECT_EQ(count, expected.at(name)) << name << ' ' << host.scenario;
            }
        }
        EXPECT_THAT(hxasim::violations(), IsEmpty());
    }
}
