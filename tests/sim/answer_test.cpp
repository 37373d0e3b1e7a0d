// What the drivers answer about the hosts of the scenarios.
#include "tests/sim/simulated_host.h"

#include <numeric>

namespace
{

using ::testing::StartsWith;

class Answers : public Simulated_Host
{
};

TEST_F(Answers, describe_an_hba_and_its_ports)
{
    hxasim::load("fc-hba");
    Open_File hxa("/dev/hxa");
    EXPECT_EQ(instances(hxa, 'C').first, 2U);

    auto second = info(hxa, 'C', 1);
    EXPECT_EQ(second.status, HXA_STATUS_OK);
    EXPECT_EQ(second.hxad_num, 1);
    EXPECT_EQ(text_of(second.serialnum), "ZMF8600123");
    EXPECT_EQ(text_of(second.hwpath), "0000:04:00.1");
    EXPECT_EQ(text_of(second.adapter_hwpath), "0000:04:00");
    EXPECT_EQ(text_of(second.name), "backup-san");
    EXPECT_EQ(text_of(second.port_name), "adapter-1-port-1");
    EXPECT_EQ(digits_of(second.pwwn), "100000051E123457");
    EXPECT_EQ(digits_of(second.nwwn), "200000051E123457");
    EXPECT_EQ(digits_of(second.mac), "000000000000");
    EXPECT_EQ(second.ioc_type, HXA_IOC_TYPE_FC);

    auto first = attributes(hxa, 'C', 0);
    EXPECT_EQ(first.state, HXA_IOC_OPERATIONAL);
    EXPECT_EQ(text_of(first.adapter_attr.manufacturer), "Zemlar");
    EXPECT_EQ(text_of(first.adapter_attr.model), "Zemlar-F86");
    EXPECT_EQ(text_of(first.driver_attr.driver), "hxa");
    EXPECT_EQ(first.adapter_attr.nports, 2);
    EXPECT_EQ(first.adapter_attr.cna_capable, 0);
    EXPECT_EQ(first.pci_attr.pcifn, 0U);
    EXPECT_EQ(attributes(hxa, 'C', 1).port_id, 1);

    auto link = port(hxa, 'C', 0);
    EXPECT_EQ(digits_of(link.pwwn), "100000051E123456");
    EXPECT_EQ(digits_of(link.factorynwwn), "200000051E123456");
    EXPECT_EQ(link.port_state, HXA_PPORT_ST_LINKUP);
    EXPECT_EQ(link.speed, 8U);
    EXPECT_EQ(link.port_type, HXA_PPORT_TYPE_NPORT);
    EXPECT_EQ(link.pport_cfg.maxfrsize, 2112);
}

TEST_F(Answers, tell_the_two_functions_of_a_converged_port_apart)
{
    hxasim::load("cna");
    Open_File hxa("/dev/hxa");
    Open_File hxn("/dev/hxn");
    auto fcoe = info(hxa, 'C', 1);
    auto ethernet = info(hxn, 'D', 1);
    EXPECT_EQ(fcoe.ioc_type, HXA_IOC_TYPE_FCoE);
    EXPECT_EQ(ethernet.ioc_type, HXA_IOC_TYPE_LL);
    EXPECT_EQ(text_of(fcoe.adapter_hwpath), text_of(ethernet.adapter_hwpath));
    EXPECT_EQ(text_of(fcoe.hwpath), "0000:04:00.1");
    EXPECT_EQ(text_of(ethernet.hwpath), "0000:04:00.3");
    EXPECT_EQ(digits_of(fcoe.mac), "00051E2A0021");
    EXPECT_EQ(digits_of(ethernet.mac), "00051E2A0011");
    EXPECT_EQ(digits_of(fcoe.pwwn), "100000051E2A0001");
    EXPECT_EQ(digits_of(ethernet.pwwn), "0000000000000000");
    EXPECT_EQ(text_of(fcoe.eth_name), "");
    EXPECT_EQ(text_of(ethernet.eth_name), "eth3");
    EXPECT_EQ(text_of(attributes(hxn, 'D', 0).driver_attr.driver), "hxn");
    EXPECT_EQ(attributes(hxn, 'D', 0).adapter_attr.cna_capable, 1);
    EXPECT_EQ(port(hxn, 'D', 0).speed, 10U);
}

TEST_F(Answers, follow_the_state_of_link_and_ioc)
{
    struct Expected
    {
        std::uint32_t state, speed, topology, frame_size;
    };
    // clang-format off
    const Expected expected[] = {
        {HXA_PPORT_ST_LINKUP,           10, HXA_PPORT_TOPOLOGY_P2P,  2112},
        {HXA_PPORT_ST_LINKDOWN,          0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_LINKUP,            2, HXA_PPORT_TOPOLOGY_LOOP, 2112},
        {HXA_PPORT_ST_DISABLED,          0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_LINKUP,           10, HXA_PPORT_TOPOLOGY_P2P,  1024},
        {HXA_PPORT_ST_PREBOOT_DISABLED,  0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_IOCDIS,            0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_IOCDIS,            0, HXA_PPORT_TOPOLOGY_NONE, 2112},
    };
    // clang-format on
    hxasim::load("mixed");
    Open_File hxa("/dev/hxa");
    std::uint16_t instance = 0;
    for (const auto& [state, speed, topology, frame_size] : expected)
    {
        SCOPED_TRACE(instance);
        auto link = port(hxa, 'C', instance++);
        EXPECT_EQ(link.port_state, state);
        EXPECT_EQ(link.speed, speed);
        EXPECT_EQ(link.topology, topology);
        EXPECT_EQ(link.pport_cfg.maxfrsize, frame_size);
    }
    EXPECT_EQ(attributes(hxa, 'C', 6).state, HXA_IOC_DISABLED);
    EXPECT_EQ(port(hxa, 'C', 2).beacon, 1U);
    EXPECT_EQ(attributes(hxa, 'C', 4).adapter_attr.is_mezz, 1);
    EXPECT_EQ(digits_of(port(hxa, 'C', 3).factorypwwn), "100000051E7F0001");
    EXPECT_EQ(digits_of(info(Open_File("/dev/hxn"), 'D', 3).current_mac), "02051E200299");
}

// Reads the block as its consumer does: sections at fixed places, keywords after one another, a checksum over all.
TEST_F(Answers, carry_vital_product_data_that_holds_together)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "fru_number": "FRU1234567890ABC"}]})");
    auto vpd = attributes(Open_File("/dev/hxa"), 'C', 0).adapter_attr.vpd;
    EXPECT_EQ(vpd.vendor, 0);
    EXPECT_EQ(vpd.data[0], 0x82);
    EXPECT_EQ(vpd.data[131], 0x90);
    std::string data(std::begin(vpd.data), std::end(vpd.data));
    EXPECT_THAT(data.substr(134), StartsWith("V0"));
    EXPECT_THAT(data.substr(153), StartsWith("V1"));
    EXPECT_THAT(data.substr(156 + 19), StartsWith("FRU1234567890ABC"));
    auto checksum_end = data.find("RV") + 4;
    auto section_end = static_cast<std::size_t>(134 + vpd.data[132] + 256 * vpd.data[133]);
    EXPECT_EQ(checksum_end, section_end);
    EXPECT_EQ(std::accumulate(vpd.data, vpd.data + checksum_end, 0) % 256, 0);
}

TEST_F(Answers, count_instances_up_to_the_highest)
{
    hxasim::load_text(R"({
        "drivers": {"hxn": {"instance_count": 129}},
        "adapters": [{"kind": "cna", "ports": [{}, {"fc_instance": 9, "eth_instance": 127}, {"eth_instance": 1}]}]})");
    auto [count, bitmap] = instances(Open_File("/dev/hxa"), 'C');
    EXPECT_EQ(count, 11U);
    EXPECT_EQ(bitmap, "0106" + std::string(60, '0'));
    std::tie(count, bitmap) = instances(Open_File("/dev/hxn"), 'D');
    EXPECT_EQ(count, 129U);
    EXPECT_EQ(bitmap, "03" + std::string(28, '0') + "80" + std::string(32, '0'));
}

TEST_F(Answers, include_refusing_the_version)
{
    hxasim::load("version-refused");
    hxa_ioctl_ioc_get_version_t record{};
    EXPECT_EQ(send(*Open_File("/dev/hxn"), "IOCMD_IOC_GET_VERSION", 'D', record), 0);
    EXPECT_EQ(record.status, HXA_STATUS_VERSION_FAIL);
    EXPECT_EQ(record.version, 0x2000U);
    hxasim::load("cna");
    record = {};
    EXPECT_EQ(send(*Open_File("/dev/hxn"), "IOCMD_IOC_GET_VERSION", 'D', record), 0);
    EXPECT_EQ(record.status, HXA_STATUS_OK);
    EXPECT_EQ(record.version, 0x1020U);
}

} // namespace
