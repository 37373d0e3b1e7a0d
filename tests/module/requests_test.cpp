// What requests answer on simulated adapters, and which driver requests they cost.

#include "tests/module/loaded_module.h"

#include <gmock/gmock.h>

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
            ids.push_back(text_of(instance, "DeviceID"));
        return ids;
    }
};

} // namespace

TEST_F(Requests, ports_cost_one_request_each)
{
    load("fc-hba");
    requests();

    EXPECT_THAT(device_ids(enumerate("ZEMLAR_FCPort")), ElementsAre("100000051E123456", "100000051E123457"));
    EXPECT_THAT(requests(), ElementsAre("IOCMD_PORT_GET_ATTR", "IOCMD_PORT_GET_ATTR"));

    EXPECT_THAT(operations().enumerate_instance_names("ZEMLAR_FCPort"), SizeIs(2));
    EXPECT_THAT(requests(), SizeIs(2));

    EXPECT_THAT(enumerate("ZEMLAR_ComputerSystem"), SizeIs(1));
    EXPECT_THAT(requests(), IsEmpty()) << "the host is described without asking a driver";
}

TEST_F(Requests, the_largest_host)
{
    load("large");
    requests();
    const auto ids = device_ids(enumerate("ZEMLAR_FCPort"));
    EXPECT_THAT(ids, SizeIs(128));
    EXPECT_THAT(requests(), AllOf(SizeIs(128), Each("IOCMD_PORT_GET_ATTR")));
    auto sorted = ids;
    std::sort(sorted.begin(), sorted.end());
    EXPECT_EQ(std::adjacent_find(sorted.begin(), sorted.end()), sorted.end());
}

TEST_F(Requests, get_instance_finds_by_keys_and_nothing_else)
{
    load("mixed");
    for (const char* class_name : {"ZEMLAR_ComputerSystem", "ZEMLAR_PortController", "ZEMLAR_FCPort"})
        for (const auto& instance : enumerate(class_name))
            EXPECT_EQ(describe(operations().get_instance(instance.path, std::nullopt)), describe(instance));

    auto elsewhere = enumerate("ZEMLAR_FCPort").at(0).path;
    elsewhere.keys.back().value.content = std::string("FFFFFFFFFFFFFFFF");
    try
    {
        operations().get_instance(elsewhere, std::nullopt);
        FAIL() << "there is no such port";
    }
    catch (const cimserver::Cim_Error& error)
    {
        EXPECT_EQ(error.code(), cimserver::CIM_ERR_NOT_FOUND);
    }
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
