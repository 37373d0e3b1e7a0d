#include "inventory/adapter_lookup.h"
#include "inventory/fchba_manager.h"
#include "tests/inventory/inventory_fixture.h"

#include <cerrno>

using namespace zmlr;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

class Adapters : public Inventory_Test
{
protected:
    static Instance_Array controllers() { return FCHBAManager::getFCHBAManager().getInstances(CLASSID_PortController); }

    static std::vector<std::string> values(const char* property) { return values_of(controllers(), property); }
};

} // namespace

TEST_F(Adapters, are_port_controllers)
{
    const Instance_Array all = controllers();
    ASSERT_EQ(all.size(), 4U);
    EXPECT_EQ(describe(all[0]), R"(ZEMLAR_PortController
    Caption = "Zemlar CNA"
    Description = "Zemlar CNA"
    ElementName = "ZMC2000456"
    Name = "ZMC2000456"
    OperationalStatus = { 11 }
    StatusDescriptions = { "The adapter is in service" }
    EnabledState = 2
    RequestedState = 12
    EnabledDefault = 2
    TransitioningToState = 12
    SystemCreationClassName = "ZEMLAR_ComputerSystem"
    SystemName = "192.0.2.10"
    CreationClassName = "ZEMLAR_PortController"
    DeviceID = "00051E300000"
    ControllerType = 1
    OtherControllerType = "CNA - FC and Ethernet types"
)");
    EXPECT_EQ(value_of(all[3], "ControllerType"), "4");
    EXPECT_EQ(value_of(all[3], "OtherControllerType"), "");
    EXPECT_THAT(values("DeviceID"),
                ElementsAre(R"("00051E300000")", R"("200000051E100100")", R"("00051E300200")", R"("200000051E100300")"));
}

TEST_F(Adapters, are_disabled_when_every_ioc_is)
{
    plug_text(R"({"adapters": [
        {"kind": "cna", "ports": [{"ioc_state": "disabled"}, {"ioc_state": "disabled"}]},
        {"kind": "fc-hba", "ports": [{"ioc_state": "disabled"}, {}]}]})");
    EXPECT_THAT(values("OperationalStatus"), ElementsAre("{ 10 }", "{ 11 }"));
    EXPECT_THAT(values("EnabledState"), ElementsAre("3", "2"));
    EXPECT_THAT(values("StatusDescriptions"),
                ElementsAre(R"({ "The adapter is disabled" })", R"({ "The adapter is in service" })"));
}

TEST_F(Adapters, cost_the_requests_of_port_0_and_of_the_state_and_one_look_up)
{
    plug_text(R"({"adapters": [{"kind": "cna", "ports": [{}]}, {"kind": "fc-hba"}]})");
    controllers();
    EXPECT_EQ(fake_host.lookups, 1);
    EXPECT_THAT(requests(),
                ElementsAre("IOCMD_IOC_GET_ATTR /dev/hxn 0", "IOCMD_IOC_GET_ATTR /dev/hxa 0", "IOCMD_IOC_GET_INFO /dev/hxa 0",
                            "IOCMD_IOC_GET_ATTR /dev/hxa 0", "IOCMD_IOC_GET_ATTR /dev/hxa 1", "IOCMD_IOC_GET_ATTR /dev/hxa 1"));
}

// One half of a CNA that answers is enough for the card; the MAC address then comes from the scan.
TEST_F(Adapters, are_read_from_what_answers)
{
    plug_text(R"({"adapters": [{"kind": "cna", "serial": "SERIAL"}]})");
    const std::string whole = describe(controllers());

    fail("IOCMD_IOC_GET_ATTR", "/dev/hxn", 0, EIO);
    log();
    EXPECT_EQ(describe(controllers()), whole);
    EXPECT_THAT(log(), Contains("ERR AdapterHelper: hxal_ioc_get_attr call to fill eth attributes failed for Adapter id 1"));

    hxasim::clear_faults();
    fail("IOCMD_IOC_GET_ATTR", "/dev/hxa", 0, EIO);
    fail("IOCMD_IOC_GET_INFO", "/dev/hxa", 0, EIO);
    EXPECT_EQ(describe(controllers()), whole);
    const std::vector<std::string> lines = log();
    EXPECT_THAT(lines, Contains("ERR AdapterHelper: hxal_ioc_get_attr call to fill fc attributes failed for Adapter id 1"));
    EXPECT_THAT(lines, Contains("WARN AdapterHelper: hxal_ioc_get_info() failed"));
    EXPECT_THAT(lines, Contains("INFO AdapterHelper: Using hxal_ioc_get_mac() to get Mac address"));
}

// Where the FC driver is missing or fails, the Ethernet side is all there is: its MAC address still tells the adapters apart.
TEST_F(Adapters, keep_a_key_of_their_own_without_the_fc_driver)
{
    plug_text(R"({"adapters": [{"kind": "cna"}, {"kind": "cna"}],
        "faults": [{"command": "IOCMD_IOC_GET_INST", "node": "/dev/hxa", "error": "EIO"}]})");
    EXPECT_THAT(values("DeviceID"), ElementsAre(R"("00051E200000")", R"("00051E200100")"));
    EXPECT_THAT(log(), Contains("WARN AdapterHelper: hxal_adapter_get_fcioc failed for adapter Index: 2"));
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(2).c_str(), "00051E200100");
    EXPECT_EQ(ProviderUtil::getAdapterId("00051E200100"), 2);
}

TEST_F(Adapters, are_skipped_one_by_one_when_they_fail)
{
    plug_text(R"({"generate": {"adapters": 3, "kind": "fc-hba", "ports": 1}})");
    fail("IOCMD_IOC_GET_ATTR", "/dev/hxa", 1, ENODEV);
    EXPECT_THAT(values("Name"), ElementsAre(R"("ZMF0000001")", R"("ZMF0000003")"));
    const std::vector<std::string> lines = log();
    EXPECT_THAT(lines, Contains("WARN AdapterHelper: hxal_ioc_get_attr falied for both fc and eth"));
    EXPECT_THAT(lines, Contains("INFO AdapterHelper: Number of instances: 2"));

    fail("IOCMD_IOC_GET_ATTR", "/dev/hxa", 0, EINTR);
    fail("IOCMD_IOC_GET_ATTR", "/dev/hxa", 2, ENOTTY);
    EXPECT_THAT(values("Name"), IsEmpty());
}

TEST_F(Adapters, have_texts_as_long_as_their_fields)
{
    plug_text(R"({"adapters": [{"kind": "fc-hba", "serial": "123456789AB\u0007", "ports": [{}]}]})");
    EXPECT_THAT(values("Name"), ElementsAre(R"("123456789AB?")"));
}
