#include "hxal/hxal.h"
#include "inventory/adapter_lookup.h"
#include "inventory/port_disabled.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <cerrno>

using namespace zmlr;
using namespace std::string_literals;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{

// Adapter 1 is a CNA with the interfaces eth0 and eth1, adapter 2 an FC HBA; both have two ports.
class Lookups : public Inventory_Test
{
protected:
    void SetUp() override
    {
        Inventory_Test::SetUp();
        plug_text(R"({"adapters": [
            {"kind": "cna", "eth_driver_version": " 2.2.0.9 "}, {"kind": "fc-hba", "fc_driver_version": "2.2.0.4"}]})");
    }
};

} // namespace

TEST_F(Lookups, find_adapters_by_address_and_say_why_there_is_none)
{
    constexpr const char* unable_wwn = "WARN ProviderUtil: Unable to get Adapter Id for adpater NWWN =";
    constexpr const char* unable_mac = "WARN ProviderUtil: Unable to get Adapter Id for adpater MAC address=";
    constexpr const char* neither = "WARN ProviderUtil: The address passed is not MAC or WWN";
    const struct
    {
        std::string address;
        int adapter;
        std::vector<std::string> log;
    } cases[] = {
        {"200000051E100000", 1, {}}, // node WWN
        {"100000051E100001", 1, {}}, // port WWN
        {"200000051e100101", 2, {}}, // lower case
        {"00051E200001", 1, {}},     // Ethernet MAC
        {"00051e300000", 1, {}},     // FCoE MAC
        {"200000051EFFFFFF", -1, {unable_wwn + "200000051EFFFFFF "s}},
        {"200000051E10000G", -1, {unable_wwn + "200000051E10000G "s}},
        {"00051EFFFFFF", -1, {unable_mac + "00051EFFFFFF "s}},
        {"00051E20000 ", -1, {unable_mac + "00051E20000  "s}},
        {"00051E2000001", -1, {neither}}, // 13 characters
        {"", -1, {neither}},
    };
    for (const auto& c : cases)
    {
        log();
        EXPECT_EQ(ProviderUtil::getAdapterId(c.address.c_str()), c.adapter) << c.address;
        EXPECT_EQ(log(), c.log) << c.address;
    }
    EXPECT_THAT(requests(), IsEmpty());
}

TEST_F(Lookups, tell_the_key_and_the_ioc_of_an_adapter)
{
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(1).c_str(), "00051E300000");
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(2).c_str(), "200000051E100100");
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(3).c_str(), "");
    EXPECT_THAT(requests(), ElementsAre("IOCMD_IOC_GET_INFO /dev/hxa 0"));

    EXPECT_EQ(hxal_ioc_get_ioc_type(ProviderUtil::getHxalHandlerByAdapterId(1)), HXA_IOC_TYPE_LL);
    EXPECT_EQ(hxal_ioc_get_ioc_type(ProviderUtil::getHxalHandlerByAdapterId(2)), HXA_IOC_TYPE_FC);
    log();
    for (const int none : {0, -1, 3})
        EXPECT_EQ(ProviderUtil::getHxalHandlerByAdapterId(none), nullptr) << none;
    EXPECT_THAT(log(), ElementsAre("ERR ProviderUtil: Unable to open handle to Adapter id 0",
                                   "ERR ProviderUtil: Invalid adapter id.", "ERR ProviderUtil: Invalid adapter id."));
}

TEST_F(Lookups, find_the_ioc_of_a_port)
{
    const hxal_t* fc = ProviderUtil::getHxalHandlerByPortWWN("100000051e100101");
    ASSERT_NE(fc, nullptr);
    EXPECT_EQ(hxal_ioc_get_port_num(fc), 1);
    EXPECT_EQ(hxal_ioc_get_ioc_type(fc), HXA_IOC_TYPE_FC);
    const hxal_t* ethernet = ProviderUtil::getHxalHandlerByPortMAC("00051E200001");
    ASSERT_NE(ethernet, nullptr);
    EXPECT_STREQ(hxal_ioc_get_eth_name(ethernet), "eth1");

    EXPECT_EQ(ProviderUtil::getHxalHandlerByPortWWN("200000051E100000"), nullptr) << "a node WWN is no port's";
    EXPECT_EQ(ProviderUtil::getHxalHandlerByPortMAC("00051E300000"), nullptr) << "an FCoE MAC is no Ethernet port's";
    EXPECT_STREQ(ProviderUtil::getEthDeviceNameByMAC("00051E200001").c_str(), "eth1");
    EXPECT_STREQ(ProviderUtil::getEthDeviceNameByMAC("00051EFFFFFF").c_str(), "");
    EXPECT_STREQ(ProviderUtil::getEthDeviceNameByMAC("eth1").c_str(), "");
    EXPECT_THAT(requests(), IsEmpty());
}

TEST_F(Lookups, read_the_driver_version_where_there_is_one)
{
    EXPECT_STREQ(ProviderUtil::getDriverVersion().c_str(), "2.2.0.9");
    EXPECT_THAT(requests(), ElementsAre("IOCMD_IOC_GET_ATTR /dev/hxn 0"));

    hxasim::inject({.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxn", .error = EIO});
    hxasim::inject({.command = "IOCMD_IOC_GET_ATTR", .instance = 0, .error = EIO});
    hxasim::inject({.command = "IOCMD_IOC_GET_ATTR", .instance = 1, .error = EIO});
    EXPECT_STREQ(ProviderUtil::getDriverVersion().c_str(), "2.2.0.4");

    plug_text(R"({"adapters": []})");
    EXPECT_STREQ(ProviderUtil::getDriverVersion().c_str(), "");
    EXPECT_THAT(log(), ElementsAre("WARN ProviderUtil: No adapters in the system!"));
}

// A port is asked on its FC side first; what it does not tell counts as in service.
TEST_F(Lookups, tell_whether_a_port_is_disabled)
{
    const std::string enabled = R"({"adapters": [{"kind": "cna"}, {"kind": "fc-hba", "ports": [{}, {"state": "disabled"}]},
        {"kind": "cna", "cna_capable": false}]})";
    const auto fc_state = [](std::uint8_t state) {
        return hxasim::Fault{.command = "IOCMD_PORT_GET_ATTR", .answer = {{8 + 324, {state}}}};
    };
    const hxasim::Fault ethernet_disabled = {.command = "IOCMD_ETHPORT_GET_ATTR", .answer = {{8 + 8, {8}}}};
    const hxasim::Fault fc_fails = {.command = "IOCMD_PORT_GET_ATTR", .error = EIO};
    const hxasim::Fault ethernet_fails = {.command = "IOCMD_ETHPORT_GET_ATTR", .error = EIO};
    const struct
    {
        const char* address;
        std::vector<hxasim::Fault> faults;
        bool disabled;
        const char* line;
    } rows[] = {
        // clang-format off
        {"", {}, false, "ERR PortHelper: ERROR: Invalid PortAddress"},
        {"00051E999999", {}, false, "ERR PortHelper: ERROR: Invalid Adapter Index"},
        {"1000000000000000", {}, false, "ERR PortHelper: ERROR: Invalid Adapter index"},
        {"100000051e100000", {}, false, "INFO PortHelper: Port Enabled"},
        {"00051e200000", {}, false, "INFO PortHelper: Port Enabled"},
        {"00051E200000", {ethernet_disabled}, true, nullptr},
        {"100000051E100000", {ethernet_disabled}, true, nullptr},
        {"00051E200000", {fc_fails, ethernet_disabled}, false, "ERR PortHelper: hxal_port_get_attr failed"},
        {"00051E200000", {ethernet_fails}, false, "ERR PortHelper: hxal_ethport_get_attr failed"},
        {"00051E200000", {fc_state(7), ethernet_fails}, true, nullptr},
        {"100000051E100101", {}, true, nullptr},
        {"100000051E100000", {fc_state(6)}, false, "INFO PortHelper: Port Enabled"},
        {"100000051E100000", {fc_state(9)}, false, "INFO PortHelper: Port Enabled"},
        {"100000051E100100", {}, false, "INFO PortHelper: Port Enabled"},
        {"100000051E100200", {ethernet_disabled}, false, "INFO PortHelper: Port Enabled"}, // not of a CNA
        {"00051E200200", {fc_state(8)}, true, nullptr},
        // clang-format on
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.address);
        plug_text(enabled);
        std::ranges::for_each(row.faults, hxasim::inject);
        EXPECT_EQ(isPortDisabled(row.address), row.disabled);
        const std::vector<std::string> said = log();
        EXPECT_TRUE(!row.line || std::ranges::find(said, row.line) != said.end());
    }
}
