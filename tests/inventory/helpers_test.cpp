// What the helpers make of whole hosts: every instance, the requests it costs, and what is left of it when something fails.
#include "inventory/adapter_lookup.h"
#include "inventory/fchba_manager.h"
#include "inventory/port_helper.h"
#include "tests/inventory/inventory_fixture.h"

#include <cerrno>
#include <cstdlib>
#include <fstream>
#include <sstream>

using namespace zmlr;
using testing::Contains;
using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsSupersetOf;

namespace
{

class Helpers : public Inventory_Test
{
protected:
    static Instance_Array all(classId_t id) { return FCHBAManager::getFCHBAManager().getInstances(id); }
};

} // namespace

TEST_F(Helpers, make_the_instances_of_the_golden_text)
{
    std::string text;
    for (const classId_t id : {CLASSID_ComputerSystem, CLASSID_PortController, CLASSID_FCPort})
        text += describe(all(id));
    if (std::getenv("ZMLR_WRITE_GOLDEN"))
        std::ofstream(GOLDEN "/mixed.txt") << text;
    std::ostringstream golden;
    golden << std::ifstream(GOLDEN "/mixed.txt").rdbuf();
    EXPECT_EQ(text, golden.str());
}

TEST_F(Helpers, cost_the_prescribed_requests_and_one_look_up_of_the_host)
{
    plug_text(R"({"adapters": [{"kind": "cna"}, {"kind": "fc-hba"}]})");
    const struct
    {
        classId_t id;
        std::vector<std::string> requests;
    } cases[] = {
        {CLASSID_ComputerSystem, {}},
        {CLASSID_PortController,
         {"IOCMD_IOC_GET_ATTR /dev/hxn 0", "IOCMD_IOC_GET_ATTR /dev/hxa 0", "IOCMD_IOC_GET_INFO /dev/hxa 0",
          "IOCMD_IOC_GET_ATTR /dev/hxa 0", "IOCMD_IOC_GET_ATTR /dev/hxa 2", "IOCMD_IOC_GET_ATTR /dev/hxa 2"}},
        {CLASSID_FCPort,
         {"IOCMD_PORT_GET_ATTR /dev/hxa 0", "IOCMD_PORT_GET_ATTR /dev/hxa 1", "IOCMD_PORT_GET_ATTR /dev/hxa 2",
          "IOCMD_PORT_GET_ATTR /dev/hxa 3"}},
    };
    for (const auto& c : cases)
    {
        fake_host.lookups = 0;
        EXPECT_FALSE(all(c.id).empty());
        EXPECT_THAT(requests(), ElementsAreArray(c.requests)) << c.id;
        EXPECT_EQ(fake_host.lookups, 1) << c.id;
    }
}

// One request of a client asks for the ports of one adapter after the other.
TEST_F(Helpers, find_ports_by_their_adapter)
{
    plug_text(R"({"adapters": [{"kind": "cna"}, {"kind": "fc-hba"}]})");
    const FCHBAManager& manager = FCHBAManager::getFCHBAManager();
    const Inventory_Request request;
    EXPECT_THAT(values_of(manager.getFCPortInstancesByAdapter("00051e200001", request), "DeviceID"),
                ElementsAre(R"("100000051E100000")", R"("100000051E100001")"));
    EXPECT_THAT(values_of(manager.getFCPortInstancesByAdapter("200000051E100100", request), "PortNumber"), ElementsAre("0", "1"));
    EXPECT_EQ(fake_host.lookups, 1);
    log();
    EXPECT_TRUE(manager.getFCPortInstancesByAdapter("00051E999999").empty());
    EXPECT_THAT(log(), Contains("WARN PortHelper: Failed to get adapterId"));
    EXPECT_TRUE(PortHelper::getPortHelperObject().getInstancesByAdapterId(99, CLASSID_FCPort).empty());
    EXPECT_THAT(log(), ElementsAre("ERR PortHelper: ERROR: Unable to open handle to Adapter id 99"));
}

// A row: a class, a host, what fails there, and what then is left of a property over all instances.
TEST_F(Helpers, skip_what_fails_and_say_so)
{
    constexpr classId_t controller = CLASSID_PortController, port = CLASSID_FCPort;
    const std::string cna = R"({"adapters": [{"kind": "cna", "serial": "SERIAL"}]})";
    const std::string hbas = R"({"generate": {"adapters": 2, "kind": "fc-hba"}})";
    const std::string nothing = R"({"adapters": []})";
    const std::string hostile = R"({"adapters": [{"kind": "fc-hba", "serial": "123456789AB\u0007"}]})";
    const std::string disabled = R"({"adapters": [
        {"kind": "cna", "ports": [{"ioc_state": "disabled"}, {"ioc_state": "disabled"}]},
        {"kind": "fc-hba", "ports": [{"ioc_state": "disabled"}, {}]}]})";
    // Where the FC driver is missing, the Ethernet side is all there is: its MAC address still tells the adapters apart.
    const std::string no_fc = R"({"adapters": [{"kind": "cna"}, {"kind": "cna"}],
        "faults": [{"command": "IOCMD_IOC_GET_INST", "node": "/dev/hxa", "error": "EIO"}]})";
    // Port 0 of the adapter has no IOC: the driver says that its only IOC drives port 1.
    const std::string port_1_only = R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}], "faults": [
        {"command": "IOCMD_IOC_GET_ATTR", "answer": [{"offset": 1600, "bytes": "01"}]}]})";
    const hxasim::Fault hxn = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxn", .error = EIO};
    const hxasim::Fault hxa = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxa", .error = EIO};
    const hxasim::Fault info = {.command = "IOCMD_IOC_GET_INFO", .error = EIO};
    const hxasim::Fault hba_1 = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxa", .instance = 0, .error = ENODEV};
    const hxasim::Fault port_1 = {.command = "IOCMD_PORT_GET_ATTR", .instance = 1, .error = EIO};
    const hxasim::Fault port_2 = {.command = "IOCMD_PORT_GET_ATTR", .instance = 2, .status = 56};
    const struct
    {
        classId_t id;
        const std::string& host;
        std::vector<hxasim::Fault> faults;
        const char* property;
        std::vector<std::string> left;
        std::vector<std::string> log;
    } rows[] = {
        // clang-format off
        {controller, cna, {hxn}, "DeviceID", {R"("00051E300000")"},
            {"ERR AdapterHelper: hxal_ioc_get_attr call to fill eth attributes failed for Adapter id 1"}},
        {controller, cna, {hxa, info}, "DeviceID", {R"("00051E300000")"}, // as the scan found it
            {"ERR AdapterHelper: hxal_ioc_get_attr call to fill fc attributes failed for Adapter id 1",
             "WARN AdapterHelper: hxal_ioc_get_info() failed",
             "INFO AdapterHelper: Using hxal_ioc_get_mac() to get Mac address"}},
        {controller, cna, {hxa}, "Name", {R"("SERIAL")"}, {"INFO AdapterHelper: Adapter Type : CNA"}},
        {controller, cna, {hxa, hxn}, "Name", {},
            {"WARN AdapterHelper: hxal_ioc_get_attr falied for both fc and eth", "INFO AdapterHelper: Number of instances: 0"}},
        {controller, no_fc, {}, "DeviceID", {R"("00051E200000")", R"("00051E200100")"},
            {"WARN AdapterHelper: hxal_adapter_get_fcioc failed for adapter Index: 2"}},
        {controller, hbas, {hba_1}, "Name", {R"("ZMF0000002")"}, {"INFO AdapterHelper: Number of instances: 1"}},
        {controller, hostile, {}, "Name", {R"("123456789AB?")"}, {"INFO AdapterHelper: Number of Adapters: 1"}},
        {controller, disabled, {}, "EnabledState", {"3", "2"}, {"INFO AdapterHelper: Adapter Type : FC HBA"}},
        {controller, disabled, {}, "StatusDescriptions",
            {R"({ "The adapter is disabled" })", R"({ "The adapter is in service" })"}, {}},
        {controller, nothing, {}, "Name", {}, {"INFO AdapterHelper: No adapters in the system!"}},
        {port, hbas, {port_1, port_2}, "DeviceID", {R"("100000051E100000")", R"("100000051E100101")"},
            {"INFO PortHelper: hxal_port_get_attr failed. Adapter=1, Port=1 ",
             "INFO PortHelper: hxal_port_get_attr failed. Adapter=2, Port=0 "}},
        {port, port_1_only, {}, "PortNumber", {"1"}, {"WARN PortHelper: Unable to get the handler. Adapter=1, Port=0. "}},
        {port, nothing, {}, "DeviceID", {}, {"INFO PortHelper: No adapters in the system. "}},
        // clang-format on
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.host + ' ' + row.property);
        plug_text(row.host);
        std::ranges::for_each(row.faults, hxasim::inject);
        EXPECT_EQ(values_of(all(row.id), row.property), row.left);
        EXPECT_THAT(log(), IsSupersetOf(row.log));
    }
}
