// A request for one instance: the same answer as the whole enumeration's, for no more requests.
#include "providers/enumerations.h"
#include "runtime/features.h"
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

// The first of them with the model's keys; empty when there is none.
std::string first_of(const Instance_Array& instances, const Instance* model)
{
    const auto first = std::ranges::find_if(instances, [model](const Instance* instance) { return key_eq(instance, model); });
    return first == instances.end() ? std::string() : describe(*first);
}

// What two cards share: a WWN that looks like a MAC address, and an interface's name that looks like a place.
constexpr const char* misleading = R"({"adapters": [
    {"kind": "cna", "ports": {"pwwn": "0000AABBCCDDEEFF", "eth_name": "interface_of_2_0"}},
    {"kind": "cna", "ports": {"pwwn": "0000AABBCCDDEEFF", "eth_name": "interface_of_2_0", "fcoe_mac": "AABBCCDDEEFF",
     "remote_ports": [{"pwwn": "0000AABBCCDDEEFF"}, {"pwwn": "0000000000000000"}]}}]})";

// A card whose FC side nobody drives, with its ports listed the other way round.
constexpr const char* ethernet_only = R"({"drivers": {"hxa": {"present": false}},
    "adapters": [{"kind": "cna", "ports": [{"eth_instance": 1}, {"eth_instance": 0}]}]})";

// With the log off, so that walks pass over adapters.
struct Wanted_One : Inventory_Test
{
    Wanted_One() { log_set_level("FATAL"); }
    ~Wanted_One() override { log_set_level("DBG"); }

    // What a request for the instance gets: the same, by the same requests, while the log takes a line of each adapter.
    std::string fetched(const Enumeration& row, const Instance* model)
    {
        log_set_level("DBG");
        requests();
        const std::string heard = first_of(instances_of(row, model, "Test_Provider"), model);
        const std::size_t cost = requests().size();
        log_set_level("FATAL");
        const auto before = hxasim::request_count();
        const std::string one = first_of(instances_of(row, model, "Test_Provider"), model);
        EXPECT_EQ(hxasim::request_count() - before, cost);
        EXPECT_EQ(one, heard);
        return one;
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
    for (const char* scenario : {"fc-hba", "cna", "mixed", "odd", "large", misleading, ethernet_only})
    {
        *scenario == '{' ? hxasim::load_text(scenario) : hxasim::load(scenario);
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
                const std::string first = first_of(all, model.ptr());
                EXPECT_EQ(fetched(row, model.ptr()), first);
                // That no other adapter tells of a driver is known only when all are read.
                if (row.id == CLASSID_AdapterSoftwareIdentity && value_of(all[i], "Classifications") == "{ 2 }")
                    continue;
                EXPECT_LE(requests().size(), cost_of_all);
                EXPECT_EQ(first_of(row.get_instances(row.id, {.host = {}, .wanted = Wanted(model.ptr())}), model.ptr()), first);
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
    for (const Enumeration& row : enumerations)
    {
        const Instance_Array all = row.get_instances(row.id, {});
        for (const Meta_Feature* feature : features_of(static_cast<const Meta_Record*>(row.meta_class)))
        {
            if (all.empty() || !is_property(feature) || !is_key(feature))
                continue;
            for (const bool is_null : {true, false})
            {
                const Ref<Instance> model = keys_of(all[0]);
                null_of(model.ptr(), as_property(feature)) = is_null;
                value_at<String>(model.ptr(), as_property(feature)->offset) = "";
                EXPECT_TRUE(Wanted(model.ptr()).is_all()) << feature->name;
            }
        }
    }
}
