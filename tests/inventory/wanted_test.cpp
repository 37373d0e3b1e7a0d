// A request for one instance: the same answer as the whole enumeration's, for fewer requests.
#include "providers/enumerations.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>

using namespace zmlr;

namespace
{

const Enumeration& row_of_class(classId_t id) { return *std::ranges::find(enumerations, id, &Enumeration::id); }

Ref<Instance> keys_of(const Instance* instance)
{
    Ref<Instance> model(create(instance->meta_class, false));
    copy_keys(model.ptr(), instance);
    return model;
}

struct Wanted_One : Inventory_Test
{
    // What a request for the instance gets; empty when it gets nothing.
    std::string fetched(const Enumeration& row, const Instance* model)
    {
        requests();
        for (const Instance* instance : instances_of(row, model, "Test_Provider"))
            if (key_eq(instance, model))
                return describe(instance);
        return {};
    }

    std::size_t cost_of(classId_t id, std::size_t position)
    {
        const Enumeration& row = row_of_class(id);
        const Instance_Array all = row.get_instances(row.id, {});
        const Ref<Instance> model = keys_of(all[static_cast<uint32>(position)]);
        EXPECT_NE(fetched(row, model.ptr()), "");
        return requests().size();
    }
};

} // namespace

TEST_F(Wanted_One, is_what_the_enumeration_tells)
{
    for (const char* scenario : {"fc-hba", "cna", "mixed", "odd"})
    {
        hxasim::load(scenario);
        hxal_adapter_scan();
        for (const Enumeration& row : enumerations)
        {
            requests();
            const Instance_Array all = row.get_instances(row.id, {});
            const std::size_t cost_of_all = requests().size();
            for (uint32 i = 0; i < all.size(); i += i < 4 ? 1 : 37)
            {
                SCOPED_TRACE(std::string(scenario) + ' ' + describe(all[i]));
                const Ref<Instance> model = keys_of(all[i]);
                const auto first = std::ranges::find_if(all, [&](const Instance* x) { return key_eq(x, model.ptr()); });
                EXPECT_EQ(fetched(row, model.ptr()), describe(*first));
                EXPECT_LE(requests().size(), 2 * cost_of_all); // what memory does not tell is found by reading all
            }
        }
    }
}

TEST_F(Wanted_One, costs_what_it_needs)
{
    plug_text(R"({"generate": {"adapters": 64, "kind": "cna"}})");
    EXPECT_EQ(cost_of(CLASSID_FCPort, 70), 1U);
    EXPECT_EQ(cost_of(CLASSID_FCPortStatistics, 70), 2U);
    EXPECT_EQ(cost_of(CLASSID_LogicalPortGroup, 70), 1U);
    EXPECT_EQ(cost_of(CLASSID_AlarmDevice, 70), 2U);
    EXPECT_EQ(cost_of(CLASSID_SCSIProtocolEndpoint, 70), 2U);
    EXPECT_EQ(cost_of(CLASSID_PortController, 40), 4U);
    EXPECT_EQ(cost_of(CLASSID_PhysicalPackage, 40), 3U);
    EXPECT_EQ(cost_of(CLASSID_AdapterSoftwareIdentity, 40), 4U);
    EXPECT_EQ(cost_of(CLASSID_EthernetPort, 70), 2U);
    EXPECT_EQ(cost_of(CLASSID_LANEndpoint, 70), 1U);
    EXPECT_EQ(cost_of(CLASSID_PhysicalConnector, 70), 1U);
    EXPECT_EQ(cost_of(CLASSID_Product, 40), 3U);

    // One unit of many: the port, its remote ports, the target and its LUN 0, its units, and the unit.
    plug_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [
        {"pwwn": "2100000F00000001", "luns": {"count": 200}}, {"pwwn": "2100000F00000002", "luns": {"count": 200}}]}]}]})");
    EXPECT_EQ(cost_of(CLASSID_StorageExtent, 250), 1U + 1U + 2U + 2U + 2U);
}

// The driver has given a port a new name since the scan: it is found by the name that an enumeration tells.
TEST_F(Wanted_One, is_found_under_a_name_that_memory_does_not_know)
{
    plug_text(R"({"adapters": [{"kind": "fc-hba"}], "faults": [
        {"command": "IOCMD_PORT_GET_ATTR", "instance": 1, "answer": [{"offset": 16, "bytes": "10000000AAAAAAAA"}]}]})");
    const Enumeration& row = row_of_class(CLASSID_FCPort);
    const Instance_Array all = row.get_instances(row.id, {});
    for (const Instance* instance : all)
        EXPECT_EQ(fetched(row, keys_of(instance).ptr()), describe(instance));
}

TEST_F(Wanted_One, with_a_key_that_is_null_or_empty_is_everything)
{
    const Ref<ZEMLAR_FCPort> model(ZEMLAR_FCPort::create());
    const Enumeration& row = row_of_class(CLASSID_FCPort);
    EXPECT_EQ(instances_of(row, model.ptr(), "Test_Provider").size(), 8U);
    for (Property<String>* key :
         {&model.ptr()->SystemCreationClassName, &model.ptr()->SystemName, &model.ptr()->CreationClassName})
        key->set("another");
    model.ptr()->DeviceID.set("");
    EXPECT_EQ(instances_of(row, model.ptr(), "Test_Provider").size(), 8U);
}
