#include "inventory/fchba_manager.h"
#include "inventory/port_helper.h"
#include "inventory/port_states.h"
#include "tests/inventory/inventory_fixture.h"

#include <cerrno>

using namespace zmlr;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

class FC_Ports : public Inventory_Test
{
protected:
    static Instance_Array ports() { return FCHBAManager::getFCHBAManager().getInstances(CLASSID_FCPort); }

    static std::vector<std::string> values(const char* property) { return values_of(ports(), property); }
};

} // namespace

TEST_F(FC_Ports, are_those_of_every_adapter)
{
    const Instance_Array all = ports();
    EXPECT_THAT(values_of(all, "DeviceID"),
                ElementsAre(R"("100000051E100000")", R"("100000051E100001")", R"("100000051E100100")", R"("100000051E100101")",
                            R"("100000051E100200")", R"("100000051E100201")", R"("100000051E100300")", R"("100000051E100301")"));
    EXPECT_THAT(values_of(all, "PortType"), ElementsAre("10", "10", "11", "10", "10", "10", "10", "10"));
    EXPECT_THAT(values_of(all, "Speed"), ElementsAre("10000000000", "0", "2000000000", "0", "10000000000", "0", "0", "0"));
    EXPECT_THAT(values_of(all, "MaxSpeed"), ElementsAre("10000000000", "10000000000", "4000000000", "4000000000", "10000000000",
                                                        "10000000000", "8000000000", "8000000000"));
    EXPECT_THAT(values_of(all, "SupportedMaximumTransmissionUnit"),
                ElementsAre("2112", "2112", "2112", "2112", "1024", "2112", "2112", "2112"));
    EXPECT_EQ(fake_host.lookups, 1);
}

TEST_F(FC_Ports, are_skipped_one_by_one_when_they_fail)
{
    plug_text(R"({"generate": {"adapters": 2, "kind": "fc-hba"}})");
    fail("IOCMD_PORT_GET_ATTR", "/dev/hxa", 1, EIO);
    hxasim::inject({.command = "IOCMD_PORT_GET_ATTR", .instance = 2, .status = 56});
    EXPECT_THAT(values("DeviceID"), ElementsAre(R"("100000051E100000")", R"("100000051E100101")"));
    const std::vector<std::string> lines = log();
    EXPECT_THAT(lines, Contains("INFO PortHelper: hxal_port_get_attr failed. Adapter=1, Port=1 "));
    EXPECT_THAT(lines, Contains("INFO PortHelper: hxal_port_get_attr failed. Adapter=2, Port=0 "));
}

TEST_F(FC_Ports, have_the_states_and_types_of_the_driver)
{
    std::string json;
    for (int state = 0; state <= 14; state++)
        json +=
            std::string(json.empty() ? "" : ",") + R"({"kind": "fc-hba", "ports": [{"state": )" + std::to_string(state) + "}]}";
    plug_text(R"({"adapters": [)" + json + "]}");
    EXPECT_THAT(values("OperationalStatus"), ElementsAre("{ 0 }", "{ 0 }", "{ 8 }", "{ 8 }", "{ 13 }", "{ 11 }", "{ 9 }", "{ 9 }",
                                                         "{ 10 }", "{ 10 }", "{ 6 }", "{ 0 }", "{ 0 }", "{ 0 }", "{ 0 }"));
    EXPECT_THAT(values("EnabledState"), ElementsAre("1", "1", "9", "9", "6", "2", "4", "4", "3", "3", "1", "1", "1", "1", "1"));

    constexpr int types[][2] = {{0, 0}, {1, 0}, {2, 10}, {5, 10}, {6, 11}, {7, 0}, {20, 11}, {21, 10}, {22, 10}, {23, 0}};
    for (const auto [driver, cim] : types)
        EXPECT_EQ(getPortType(static_cast<uint32>(driver)), cim) << driver;
}

TEST_F(FC_Ports, have_what_a_hostile_driver_says)
{
    constexpr std::size_t attributes = 8; // where they begin in the record
    const std::vector<std::uint8_t> ones(4, 0xFF);
    plug_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{"symbolic_name": "a\u001bb\u0000c"}]}]})");
    EXPECT_THAT(values("Caption"), ElementsAre(R"("a?b")"));

    hxasim::inject({.command = "IOCMD_PORT_GET_ATTR",
                    .answer = {{.offset = attributes + 40, .bytes = std::vector<std::uint8_t>(256, 0xC3)}, // a text without end
                               {.offset = attributes + 296, .bytes = ones},                                // speed_supported
                               {.offset = attributes + 310, .bytes = {0xFF, 0xFF}},                        // maxfrsize
                               {.offset = attributes + 324, .bytes = ones},                                // port_state
                               {.offset = attributes + 328, .bytes = ones},                                // speed
                               {.offset = attributes + 352, .bytes = ones}}});                             // port_type
    EXPECT_THAT(values("Caption"), ElementsAre('"' + std::string(255, '?') + '"'));
    EXPECT_THAT(values("Speed"), ElementsAre("4294967295000000000"));
    EXPECT_THAT(values("MaxSpeed"), ElementsAre("4294967295000000000"));
    EXPECT_THAT(values("SupportedMaximumTransmissionUnit"), ElementsAre("65535"));
    EXPECT_THAT(values("OperationalStatus"), ElementsAre("{ 0 }"));
    EXPECT_THAT(values("PortType"), ElementsAre("0"));
}

TEST_F(FC_Ports, are_found_by_their_adapter)
{
    plug_text(R"({"adapters": [{"kind": "cna"}, {"kind": "fc-hba"}]})");
    const FCHBAManager& manager = FCHBAManager::getFCHBAManager();
    EXPECT_THAT(values_of(manager.getFCPortInstancesByAdapter("00051e200001"), "DeviceID"),
                ElementsAre(R"("100000051E100000")", R"("100000051E100001")"));
    EXPECT_THAT(values_of(manager.getFCPortInstancesByAdapter("200000051E100100"), "PortNumber"), ElementsAre("0", "1"));
    log();
    EXPECT_THAT(values_of(manager.getFCPortInstancesByAdapter("00051E999999"), "DeviceID"), IsEmpty());
    EXPECT_THAT(log(), Contains("WARN PortHelper: Failed to get adapterId"));
}

TEST_F(FC_Ports, are_left_out_where_there_is_none)
{
    const PortHelper& helper = PortHelper::getPortHelperObject();
    EXPECT_TRUE(helper.getInstancesByClass(CLASSID_ComputerSystem).empty());
    EXPECT_THAT(log(), Contains("INFO PortHelper: Unhandled class support"));
    EXPECT_TRUE(helper.getInstancesByAdapterId(99, CLASSID_FCPort).empty());
    EXPECT_THAT(log(), Contains("ERR PortHelper: ERROR: Unable to open handle to Adapter id 99"));

    // Port 0 of the adapter has no IOC: the driver says that its only IOC drives port 1.
    plug_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}], "faults": [
        {"command": "IOCMD_IOC_GET_ATTR", "answer": [{"offset": 1600, "bytes": "01"}]}]})");
    EXPECT_THAT(values("PortNumber"), ElementsAre("1"));
    EXPECT_THAT(log(), Contains("WARN PortHelper: Unable to get the handler. Adapter=1, Port=0. "));

    plug_text(R"({"adapters": []})");
    EXPECT_TRUE(ports().empty());
    EXPECT_THAT(log(), Contains("INFO PortHelper: No adapters in the system. "));
}
