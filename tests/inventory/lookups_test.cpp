#include "hxal/hxal.h"
#include "inventory/adapter_lookup.h"
#include "tests/inventory/inventory_fixture.h"

#include <cerrno>

using namespace zmlr;
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

TEST_F(Lookups, find_adapters_by_address)
{
    constexpr std::pair<const char*, int> cases[] = {
        {"200000051E100000", 1}, // node WWN
        {"100000051E100001", 1}, // port WWN
        {"200000051e100101", 2}, // lower case
        {"00051E200001", 1},     // Ethernet MAC
        {"00051e300000", 1},     // FCoE MAC
    };
    for (const auto& [address, adapter] : cases)
        EXPECT_EQ(ProviderUtil::getAdapterId(address), adapter) << address;
    EXPECT_THAT(requests(), IsEmpty());
}

TEST_F(Lookups, say_why_there_is_no_adapter)
{
    constexpr const char* unable_wwn = "WARN ProviderUtil: Unable to get Adapter Id for adpater NWWN =";
    constexpr const char* unable_mac = "WARN ProviderUtil: Unable to get Adapter Id for adpater MAC address=";
    constexpr const char* neither = "WARN ProviderUtil: The address passed is not MAC or WWN";
    const std::pair<const char*, std::string> cases[] = {
        {"200000051EFFFFFF", std::string(unable_wwn) + "200000051EFFFFFF "},
        {"200000051E10000G", std::string(unable_wwn) + "200000051E10000G "},
        {"00051EFFFFFF", std::string(unable_mac) + "00051EFFFFFF "},
        {"00051E20000 ", std::string(unable_mac) + "00051E20000  "},
        {"00051E2000001", neither}, // 13 characters
        {"", neither},
    };
    for (const auto& [address, line] : cases)
    {
        log();
        EXPECT_EQ(ProviderUtil::getAdapterId(address), -1) << address;
        EXPECT_THAT(log(), ElementsAre(line));
    }
    EXPECT_THAT(requests(), IsEmpty());
}

TEST_F(Lookups, tell_the_key_of_an_adapter)
{
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(1).c_str(), "00051E300000");
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(2).c_str(), "200000051E100100");
    EXPECT_THAT(requests(), ElementsAre("IOCMD_IOC_GET_INFO /dev/hxa 0"));
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(0).c_str(), "");
    EXPECT_STREQ(ProviderUtil::getAddrByAdapterId(3).c_str(), "");
}

TEST_F(Lookups, find_the_ioc_of_an_adapter)
{
    EXPECT_EQ(hxal_ioc_get_ioc_type(ProviderUtil::getHxalHandlerByAdapterId(1)), HXA_IOC_TYPE_LL);
    EXPECT_EQ(hxal_ioc_get_ioc_type(ProviderUtil::getHxalHandlerByAdapterId(2)), HXA_IOC_TYPE_FC);
    log();
    EXPECT_EQ(ProviderUtil::getHxalHandlerByAdapterId(0), nullptr);
    EXPECT_EQ(ProviderUtil::getHxalHandlerByAdapterId(-1), nullptr);
    EXPECT_EQ(ProviderUtil::getHxalHandlerByAdapterId(3), nullptr);
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
    EXPECT_EQ(ProviderUtil::getHxalHandlerByPortWWN(""), nullptr);
    EXPECT_STREQ(ProviderUtil::getEthDeviceNameByMAC("00051E200001").c_str(), "eth1");
    EXPECT_STREQ(ProviderUtil::getEthDeviceNameByMAC("00051EFFFFFF").c_str(), "");
    EXPECT_STREQ(ProviderUtil::getEthDeviceNameByMAC("eth1").c_str(), "");
    EXPECT_THAT(requests(), IsEmpty());
}

TEST_F(Lookups, read_the_driver_version_where_there_is_one)
{
    EXPECT_STREQ(ProviderUtil::getDriverVersion().c_str(), "2.2.0.9");
    EXPECT_THAT(requests(), ElementsAre("IOCMD_IOC_GET_ATTR /dev/hxn 0"));

    fail("IOCMD_IOC_GET_ATTR", "/dev/hxn", std::nullopt, EIO);
    fail("IOCMD_IOC_GET_ATTR", "/dev/hxa", 0, EIO);
    fail("IOCMD_IOC_GET_ATTR", "/dev/hxa", 1, EIO);
    EXPECT_STREQ(ProviderUtil::getDriverVersion().c_str(), "2.2.0.4");

    plug_text(R"({"adapters": []})");
    EXPECT_STREQ(ProviderUtil::getDriverVersion().c_str(), "");
    EXPECT_THAT(log(), ElementsAre("WARN ProviderUtil: No adapters in the system!"));
}
