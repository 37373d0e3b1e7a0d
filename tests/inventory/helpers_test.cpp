// What the helpers make of whole hosts: every instance, the requests it costs, and what is left of it when something fails.
#include "inventory/adapter_lookup.h"
#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"
#include "inventory/port_helper.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <cerrno>
#include <cstring>

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
    static Instance_Array all(classId_t id)
    {
        const bool is_storage = id == CLASSID_StorageExtent || id == CLASSID_TapeDrive;
        return is_storage ? HDRManager::getHDRManager().getInstances(id) : FCHBAManager::getFCHBAManager().getInstances(id);
    }
};

} // namespace

// What one CNA costs, with a disk behind its first port; sixteen cost sixteen times as much.
TEST_F(Helpers, cost_the_prescribed_requests_and_one_look_up_of_the_host)
{
    const std::string card = R"({"kind": "cna", "ports": [
        {"remote_ports": [{"pwwn": "2100000F00000001", "luns": {"count": 1}}, {"pwwn": "2100000F00000002", "function": "initiator"}]}, {}]})";
    const std::vector<std::string> attributes = {"IOC_GET_ATTR", "IOC_GET_ATTR", "IOC_GET_INFO"};
    const struct
    {
        classId_t id;
        std::vector<std::string> commands;
    } rows[] = {
        // clang-format off
        {CLASSID_PortController,          {"IOC_GET_ATTR", "IOC_GET_ATTR", "IOC_GET_INFO", "IOC_GET_ATTR"}},
        {CLASSID_PhysicalPackage,         attributes},
        {CLASSID_Product,                 attributes},
        {CLASSID_AdapterSoftwareIdentity, {"IOC_GET_ATTR", "IOC_GET_ATTR", "IOC_GET_INFO", "FLASH_GET_ATTR"}},
        {CLASSID_FCPort,                  {"PORT_GET_ATTR", "PORT_GET_ATTR"}},
        {CLASSID_FCPortStatistics,        {"PORT_GET_ATTR", "PORT_GET_STATS", "PORT_GET_ATTR", "PORT_GET_STATS"}},
        {CLASSID_LogicalPortGroup,        {"PORT_GET_ATTR", "PORT_GET_ATTR"}},
        {CLASSID_AlarmDevice,             {"PORT_GET_ATTR", "IOC_GET_ATTR", "PORT_GET_ATTR", "IOC_GET_ATTR"}},
        {CLASSID_SCSIProtocolEndpoint,    {"PORT_GET_ATTR", "LPORT_GET_RPORTS", "RPORT_GET_ATTR", "RPORT_GET_ATTR",
                                           "PORT_GET_ATTR", "LPORT_GET_RPORTS"}},
        {CLASSID_EthernetPort,            {"ETHPORT_GET_ATTR", "DIAG_SFP", "ETHPORT_GET_ATTR", "DIAG_SFP"}},
        {CLASSID_LANEndpoint,             {"ETHPORT_GET_ATTR", "ETHPORT_GET_ATTR"}},
        {CLASSID_PhysicalConnector,       {"DIAG_SFP", "DIAG_SFP"}},
        {CLASSID_StorageExtent,           {"PORT_GET_ATTR", "LPORT_GET_RPORTS", "RPORT_GET_ATTR", "SCSI_CMND", "SCSI_CMND",
                                           "SCSI_CMND", "SCSI_CMND", "RPORT_GET_ATTR", "PORT_GET_ATTR", "LPORT_GET_RPORTS"}},
        {CLASSID_TapeDrive,               {"PORT_GET_ATTR", "LPORT_GET_RPORTS", "RPORT_GET_ATTR", "SCSI_CMND", "RPORT_GET_ATTR",
                                           "PORT_GET_ATTR", "LPORT_GET_RPORTS"}},
        // clang-format on
    };
    for (const int cards : {1, 16})
    {
        std::string adapters = card;
        for (int i = 1; i < cards; i++)
            adapters += ", " + card;
        plug_text(R"({"adapters": [)" + adapters + "]}");
        for (const auto& row : rows)
        {
            std::vector<std::string> expected;
            for (int i = 0; i < cards; i++)
                for (const std::string& command : row.commands)
                    expected.push_back("IOCMD_" + command);
            fake_host.lookups = 0;
            all(row.id);
            EXPECT_EQ(commands(), expected) << row.id;
            EXPECT_LE(fake_host.lookups, 1) << row.id;
        }
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
    EXPECT_THAT(values_of(manager.getEthernetPortInstancesByAdapter("00051e200001"), "DeviceID"),
                ElementsAre(R"("00051E200000")", R"("00051E200001")"));
    EXPECT_TRUE(manager.getEthernetPortInstancesByAdapter("200000051E100000").empty()) << "a WWN";
    EXPECT_THAT(log(), Contains("WARN EthernetPortHelper: Failed to get adapterId"));
    EXPECT_TRUE(manager.getFCPortInstancesByAdapter("00051E999999").empty());
    EXPECT_THAT(log(), Contains("WARN PortHelper: Failed to get adapterId"));
    EXPECT_TRUE(PortHelper::getPortHelperObject().getInstancesByAdapterId(99, CLASSID_FCPort).empty());
    EXPECT_THAT(log(), ElementsAre("ERR PortHelper: ERROR: Unable to open handle to Adapter id 99"));
}

// What one side of a card does not tell, its other side or the library's memory does. A row: a class, a host, what fails there,
// and what is left of a property over all instances.
TEST_F(Helpers, let_the_other_side_of_a_card_stand_in)
{
    const std::string cna = R"({"adapters": [{"kind": "cna", "serial": "SERIAL"}]})";
    const std::string hba_and_cna = R"({"adapters": [{"kind": "fc-hba"}, {"kind": "cna"}]})";
    // Where the FC driver is missing, the Ethernet side is all there is: its MAC address still tells the adapters apart.
    const std::string no_fc = R"({"adapters": [{"kind": "cna"}, {"kind": "cna"}],
        "faults": [{"command": "IOCMD_IOC_GET_INST", "node": "/dev/hxa", "error": "EIO"}]})";
    const std::string no_ethernet = R"({"adapters": [{"kind": "cna"}],
        "faults": [{"command": "IOCMD_IOC_GET_INST", "node": "/dev/hxn", "error": "EIO"}]})";
    // Port 0 of the adapter has no IOC: the driver says that its only IOC drives port 1.
    const std::string port_1_only = R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}], "faults": [
        {"command": "IOCMD_IOC_GET_ATTR", "answer": [{"offset": 1600, "bytes": "01"}]}]})";
    // Which counters come is decided by the IOC, which are looked for by the card.
    const std::string strange = R"({"adapters": [
        {"kind": "cna", "cna_capable": false, "ports": [{"counters": {"from": 1000}}]},
        {"kind": "fc-hba", "cna_capable": true, "ports": [{"counters": {"from": 2000}}]}]})";
    const hxasim::Fault hxn = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxn", .error = EIO};
    const hxasim::Fault hxa = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxa", .error = EIO};
    const hxasim::Fault other_serial = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxn", .answer = {{8 + 8 + 8, {'E', 0}}}};
    const hxasim::Fault info = {.command = "IOCMD_IOC_GET_INFO", .error = EIO};
    const hxasim::Fault fcoe = {.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxa", .instance = 2, .error = EIO};
    const hxasim::Fault no_sfp = {.command = "IOCMD_DIAG_SFP", .node = "/dev/hxn", .instance = 0, .status = 89};
    const hxasim::Fault fc_side = {.command = "IOCMD_DIAG_SFP", .node = "/dev/hxa", .error = EIO};
    const hxasim::Fault no_partition = {.command = "IOCMD_FLASH_GET_ATTR", .answer = {{8 + 4, {0, 0, 0, 0}}}};
    const struct
    {
        classId_t id;
        const std::string& host;
        std::vector<hxasim::Fault> faults;
        const char* property;
        std::vector<std::string> left;
    } rows[] = {
        // clang-format off
        {CLASSID_PortController,    cna,         {hxn},             "DeviceID",    {R"("00051E300000")"}},
        {CLASSID_PortController,    cna,         {hxa, info},       "DeviceID",    {R"("00051E300000")"}}, // as the scan found it
        {CLASSID_PortController,    cna,         {hxa},             "Name",        {R"("SERIAL")"}},
        {CLASSID_PortController,    cna,         {other_serial},    "Name",        {R"("E")"}}, // the Ethernet side tells of the card
        {CLASSID_PortController,    no_fc,       {},                "DeviceID",    {R"("00051E200000")", R"("00051E200100")"}},
        {CLASSID_FCPort,            port_1_only, {},                "PortNumber",  {"1"}},
        {CLASSID_FCPortStatistics,  strange,     {},                "DumpedFrames", {"0", "0"}},
        {CLASSID_EthernetPort,      cna,         {no_sfp, fc_side}, "PortType",    {"0", "105"}},
        {CLASSID_PhysicalConnector, cna,         {no_sfp, fc_side}, "Tag",         {R"("SERIAL-1_1_1")"}},
        {CLASSID_PhysicalConnector, no_fc,       {},                "Description", {4, R"("10G_BASE-SR")"}},
        {CLASSID_PhysicalConnector, no_ethernet, {},                "Description", {2, R"("10G_BASE-SR")"}},
        {CLASSID_AdapterSoftwareIdentity, cna,   {no_partition},    "Classifications", {"{ 2 }", "{ 2 }", "{ 10 }"}},
        {CLASSID_AdapterSoftwareIdentity, hba_and_cna, {fcoe},      "Classifications", // a storage driver, then a network driver
         {"{ 2 }", "{ 11 }", "{ 10 }", "{ 2 }", "{ 10 }"}},
        // clang-format on
    };
    for (const auto& row : rows)
    {
        plug_text(row.host);
        std::ranges::for_each(row.faults, hxasim::inject);
        EXPECT_EQ(values_of(all(row.id), row.property), row.left) << row.host << ' ' << row.property;
    }
}

// The target's 101 units just fit into the first list.
TEST_F(Helpers, ask_units_with_the_room_for_what_they_may_answer)
{
    plug_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [
        {"pwwn": "2100000F00000001", "luns": {"count": 101, "identification": "none"}}]}]}]})");
    all(CLASSID_StorageExtent);
    std::vector<std::vector<std::uint32_t>> asked; // command, page and its length; room for data and sense
    for (const hxasim::Request& request : hxasim::take_requests())
    {
        hxa_ioctl_scsi_t scsi = {};
        std::memcpy(&scsi, request.sent.data(), std::min(request.sent.size(), sizeof scsi));
        const auto& cdb = scsi.cdb.scsi_cdb;
        if (request.name == "IOCMD_LPORT_GET_RPORTS")
        {
            EXPECT_THAT(std::vector(&request.sent[24], &request.sent[28]), ElementsAre(255, 0, 0, 0));
        }
        if (request.name == "IOCMD_SCSI_CMND" && asked.size() < 5)
            asked.push_back({cdb[0], cdb[1], cdb[2], cdb[4], scsi.iosz, scsi.snssz});
    }
    EXPECT_THAT(asked, ElementsAre(ElementsAre(0x12, 0, 0, 36, 36, 18), ElementsAre(0xA0, 0, 0, 0, 816, 18),
                                   ElementsAre(0x12, 0, 0, 36, 36, 18), ElementsAre(0x12, 1, 0x83, 40, 40, 18),
                                   ElementsAre(0x12, 1, 0x80, 36, 36, 18)));
}

// However many units a target tells of, it is asked twice at most, not for more than there can be, and told no more than fit.
TEST_F(Helpers, believe_no_number_of_units)
{
    plug_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [
        {"pwwn": "2100000F00000001", "report_luns": "FFFFFFF8"}]}]}]})");
    hxasim::inject({.cdb = {0xA0}, .error = EIO, .skip = 1}); // the second answer ends it
    EXPECT_TRUE(all(CLASSID_StorageExtent).empty());
    const std::vector<hxasim::Request> sent = hxasim::take_requests();
    hxa_ioctl_scsi_t last;
    std::memcpy(&last, sent.back().sent.data(), sizeof last);
    EXPECT_EQ(last.iosz, 65536U * 8 + 8);
    EXPECT_THAT(log(), IsSupersetOf({"ERR TargetHelper: hxal_scsi_reportluns returned error -  42",
                                     "INFO TargetHelper: Continue with next rport. Reportlun had issue. "}));

    plug_text(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [{"luns": {"count": 102}}]}]}]})");
    hxasim::inject({.cdb = {0xA0}, .skip = 1, .data = {{2, {0x10}}}}); // 512 units more
    EXPECT_EQ(all(CLASSID_StorageExtent).size(), 102U);
    EXPECT_THAT(log(), testing::Contains("INFO TargetHelper: Number of Luns = 102."));
}
