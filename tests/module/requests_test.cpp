// What requests answer on simulated adapters, and which driver requests they cost.

#include "tests/module/loaded_module.h"

#include <gmock/gmock.h>

#include <algorithm>

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

TEST_F(Requests, PortsCostOneRequestEach)
{
    load("fc-hba");
    requests();

    EXPECT_THAT(device_ids(enumerate("ZEMLAR_FCPort")), ElementsAre("100000051E123456", "100000051E123457"));
    EXPECT_THAT(requests(), ElementsAre("IOCMD_PORT_GET_ATTR", "IOCMD_PORT_GET_ATTR"));

    EXPECT_THAT(operations().enumerate_instance_names(name_space, "ZEMLAR_FCPort"), SizeIs(2));
    EXPECT_THAT(requests(), SizeIs(2));

    EXPECT_THAT(enumerate("ZEMLAR_ComputerSystem"), SizeIs(1));
    EXPECT_THAT(requests(), IsEmpty()) << "the host is described without asking a driver";
}

TEST_F(Requests, LargestHost)
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

TEST_F(Requests, GetInstanceFindsByKeysAndNothingElse)
{
    load("mixed");
    const auto ports = enumerate("ZEMLAR_FCPort");
    ASSERT_GT(ports.size(), 2U);
    for (const auto& port : ports)
        EXPECT_EQ(text_of(operations().get_instance(port.path, std::nullopt), "Name"), text_of(port, "Name"));

    auto elsewhere = ports[0].path;
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

TEST_F(Requests, HostileTextsArriveAsPlainText)
{
    load_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{}, {}]}],
        "faults": [{"command": "IOCMD_PORT_GET_ATTR", "answer": {"offset": 48, "bytes": "0141C0808022FF"}}]})");
    const auto ports = enumerate("ZEMLAR_FCPort");
    ASSERT_THAT(ports, SizeIs(2));
    EXPECT_EQ(text_of(ports[0], "Caption").substr(0, 7), "?A???\"?");
}

TEST_F(Requests, EveryClassAnswersOnEveryHost)
{
    for (const char* scenario : {"fc-hba", "cna", "mixed", "large", "no-driver", "version-refused"})
    {
        SCOPED_TRACE(scenario);
        load(scenario);
        for (const auto* meta_class : operations().enumerate_classes(name_space, "", true))
        {
            if (std::string_view(meta_class->name).starts_with("ZEMLAR_"))
            {
                EXPECT_NO_THROW(enumerate(meta_class->name)) << meta_class->name;
            }
        }
        EXPECT_THAT(hxasim::violations(), IsEmpty());
    }
}
