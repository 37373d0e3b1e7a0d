#include "tests/hxal/library_fixture.h"

#include <cerrno>

namespace
{

using testing::Each;

// Adapter 1 is the CNA: its FC instances come first.
class Adapter : public Library_Test
{
protected:
    Adapter()
    {
        scan(R"({"adapters": [
            {"kind": "fc-hba", "name": "red", "serial": "R1", "hwpath": "0000:01:00",
             "ports": [{"fc_instance": 2}, {"fc_instance": 3}]},
            {"kind": "cna", "name": "blue", "serial": "B1", "hwpath": "0000:02:00",
             "ports": [{"fc_instance": 0}, {"fc_instance": 1}]}]})");
        cna = hxal_adapter_open_idx(1);
        hba = hxal_adapter_open_idx(2);
    }

    const hxal_adapter_t* cna = nullptr;
    const hxal_adapter_t* hba = nullptr;
};

TEST_F(Adapter, groups_the_iocs_of_one_card_by_port_in_the_order_of_the_lowest_instance)
{
    EXPECT_STREQ(cna->name, "blue");
    EXPECT_EQ(cna->id, 1);
    EXPECT_EQ(hxal_adapter_get_num_ioc(1), 4);
    EXPECT_EQ(hxal_adapter_get_num_port(1), 2);
    EXPECT_EQ(hxal_adapter_is_cna_capable(1), HXA_TRUE);
    for (int port : {0, 1})
    {
        const hxal_t* fc = hxal_adapter_get_fcioc(cna, port);
        const hxal_t* ethernet = hxal_adapter_get_ethioc(cna, port);
        ASSERT_TRUE(fc && ethernet);
        EXPECT_EQ(fc->id, port);
        EXPECT_EQ(fc->port_num, port);
        EXPECT_EQ(fc->pwwn, port_wwn(1, static_cast<uint8_t>(port)));
        EXPECT_EQ(ethernet->id, port);
        EXPECT_EQ(hxal_adapter_get_ioc(cna, port), fc);
    }
    char serial[12], model[128], hwpath[32];
    hxal_adapter_get_serial_num(cna, serial);
    hxal_adapter_get_model(cna, model);
    hxal_adapter_get_hw_path(cna, hwpath);
    hxal_adapter_get_hw_path(nullptr, hwpath);
    EXPECT_STREQ(serial, "B1");
    EXPECT_STREQ(model, cna->model_descr);
    EXPECT_STREQ(hwpath, "0000:02:00");
    EXPECT_STREQ(hxal_adapter_get_serial_num_by_idx(2), "R1");
    EXPECT_EQ(hxal_adapter_get_num_ioc(2), 2);
    EXPECT_TRUE(!hba->ethioc_list && !hba->next && !hxal_adapter_is_cna_capable(2));
}

TEST_F(Adapter, is_found_by_index_serial_name_path_and_address)
{
    EXPECT_TRUE(hxal_adapter_get_by_idx(2) == hba && hxal_adapter_lookup("R1") == hba);
    const int64_t twos[] = {hxal_adapter_get_num(),
                            hxal_adapter_get_count(),
                            hxal_adapter_open_by_name("R1"),
                            hxal_adapter_open_by_name("red"),
                            hxal_adapter_get_idx_by_name("red"),
                            hxal_adapter_get_idx_by_sn("R1"),
                            hxal_adapter_get_idx_by_hwpath("0000:01:00"),
                            hxal_adapter_open_by_wwn(port_wwn(0, 1)),
                            hxal_adapter_open_by_wwn(node_wwn(0, 1))};
    EXPECT_THAT(twos, Each(2));
    const int64_t ones[] = {hxal_adapter_get_by_pwwn(node_wwn(1, 0)), hxal_adapter_get_by_mac(fcoe_mac(1, 1)),
                            hxal_adapter_get_by_mac(eth_mac(1, 0))};
    EXPECT_THAT(ones, Each(1));
}

TEST_F(Adapter, that_does_not_exist_is_null_or_0_or_minus_1)
{
    for (int ad : {-1, 0, 3, INT_MAX})
    {
        SCOPED_TRACE(ad);
        EXPECT_TRUE(!hxal_adapter_open_idx(ad) && !hxal_adapter_get_by_idx(ad) && !hxal_adapter_get_port(ad));
        EXPECT_EQ(hxal_adapter_get_name(static_cast<unsigned>(ad)), nullptr);
        const int numbers[] = {
            hxal_adapter_get_num_ioc(ad), hxal_adapter_get_num_port(ad), hxal_adapter_get_ioc_idx_by_pwwn(ad, port_wwn(1, 0)),
            hxal_adapter_get_ioc_idx_by_mac(ad, eth_mac(1, 0)), hxal_adapter_get_ioc_idx_by_hwpath(ad, "0000:02:00.0")};
        EXPECT_THAT(numbers, Each(-1));
        EXPECT_FALSE(hxal_adapter_is_cna_capable(ad) || hxal_adapter_is_enabled(ad) || hxal_adapter_is_disabled(ad));
    }
    EXPECT_EQ(hxal_adapter_get_serial_num_by_idx(0xFFFF), nullptr);
    EXPECT_TRUE(!hxal_adapter_lookup("red") && !hxal_adapter_lookup(nullptr));
    EXPECT_FALSE(hxal_adapter_open_by_name("green") || hxal_adapter_get_idx_by_name(nullptr) ||
                 hxal_adapter_get_idx_by_sn("red") || hxal_adapter_get_idx_by_hwpath("0000:01:00.0") ||
                 hxal_adapter_open_by_wwn(1) || hxal_adapter_get_by_mac(mac_t{{1}}));
    EXPECT_EQ(hxal_adapter_get_by_pwwn(1) & hxal_adapter_get_pcifn(1), -1);
    EXPECT_THAT(commands(), testing::IsEmpty());
}

TEST_F(Adapter, finds_its_ports)
{
    const int found[] = {hxal_adapter_get_ioc_idx_by_pwwn(1, port_wwn(1, 1)), hxal_adapter_get_ioc_idx_by_pwwn(1, node_wwn(1, 1)),
                         hxal_adapter_get_ioc_idx_by_mac(1, eth_mac(1, 1)), hxal_adapter_get_ioc_idx_by_hwpath(1, "0000:02:00.1"),
                         hxal_adapter_get_pcifn(port_wwn(0, 1))};
    EXPECT_THAT(found, Each(1));
    EXPECT_EQ(hxal_adapter_get_ioc_idx_by_hwpath(1, "0000:02:00.2"), 0);
    const int missing[] = {hxal_adapter_get_ioc_idx_by_pwwn(2, port_wwn(1, 1)),
                           hxal_adapter_get_ioc_idx_by_mac(1, fcoe_mac(1, 1)), hxal_adapter_get_ioc_idx_by_hwpath(1, nullptr),
                           hxal_adapter_get_pcifn(node_wwn(0, 1))};
    EXPECT_THAT(missing, Each(-1));
    EXPECT_EQ(hxal_adapter_get_port_by_wwn(2, node_wwn(0, 1)), hxal_ioc_open_idx(3));
    EXPECT_EQ(hxal_adapter_get_port_by_wwn(1, node_wwn(0, 1)), nullptr);
    EXPECT_EQ(hxal_adapter_get_port(1), cna->fcioc_list);
    EXPECT_EQ(hxal_adapter_get_first_ioc(hba), hba->fcioc_list);
    EXPECT_STREQ(hxal_adapter_get_fcioc_hwpath(hba, 1), "0000:01:00.1");
    EXPECT_STREQ(hxal_adapter_get_ethioc_hwpath(cna, 0), "0000:02:00.2");
    EXPECT_EQ(hxal_adapter_get_ioc_pwwn(hba, 1), port_wwn(0, 1));

    for (int port : {-1, 2, INT_MAX})
        EXPECT_EQ(hxal_adapter_get_ioc(cna, port), nullptr) << port;
    EXPECT_FALSE(hxal_adapter_get_fcioc_hwpath(hba, 2) || hxal_adapter_get_ethioc_hwpath(hba, 0) ||
                 hxal_adapter_get_ioc_pwwn(hba, 2) || hxal_adapter_get_ioc(nullptr, 0) || hxal_adapter_get_first_ioc(nullptr));
}

TEST_F(Adapter, refreshes_its_name_unless_the_request_fails)
{
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, name), {'n', 'e', 'w', 0}, 2);
    EXPECT_STREQ(hxal_adapter_get_name(2), "new");
    EXPECT_STREQ(hba->name, "new");
    EXPECT_THAT(commands(), testing::ElementsAre("IOCMD_IOC_GET_INFO"));

    fail("IOCMD_IOC_GET_INFO", EIO, 0);
    EXPECT_STREQ(hxal_adapter_get_name(1), "blue");
}

TEST_F(Adapter, is_enabled_or_disabled_when_every_ioc_says_so)
{
    EXPECT_EQ(hxal_adapter_is_enabled(1), HXA_TRUE);
    EXPECT_EQ(commands().size(), 4u);
    EXPECT_EQ(hxal_adapter_is_disabled(1), HXA_FALSE);
    EXPECT_EQ(commands().size(), 1u);

    const std::size_t state = offsetof(hxa_ioctl_ioc_attr_t, attr) + offsetof(hxa_ioc_attr_t, state);
    distort("IOCMD_IOC_GET_ATTR", state, {HXA_IOC_DISABLED}, 1, "/dev/hxn");
    EXPECT_EQ(hxal_adapter_is_enabled(1), HXA_FALSE);
    EXPECT_EQ(hxal_adapter_is_enabled(2), HXA_TRUE);

    hxasim::clear_faults();
    distort("IOCMD_IOC_GET_ATTR", state, {HXA_IOC_DISABLED}, {}, "");
    EXPECT_EQ(hxal_adapter_is_disabled(1), HXA_TRUE);

    hxasim::clear_faults();
    fail("IOCMD_IOC_GET_ATTR", EIO, 3);
    testing::internal::CaptureStdout();
    EXPECT_EQ(hxal_adapter_is_enabled(2), HXA_FALSE);
    testing::internal::GetCapturedStdout();
}

TEST_F(Adapter, with_ethernet_iocs_only_comes_last_and_is_found_by_mac)
{
    ASSERT_EQ(scan(R"({"adapters": [{"kind": "cna"}], "drivers": {"hxa": {"present": false}}})"), 1);
    const hxal_adapter_t* ad = hxal_adapter_open_idx(1);
    EXPECT_EQ(ad->fcioc_list, nullptr);
    EXPECT_EQ(hxal_adapter_get_first_ioc(ad), ad->ethioc_list);
    EXPECT_EQ(hxal_adapter_get_ioc(ad, 1), ad->ethioc_list->next);
    EXPECT_EQ(hxal_adapter_get_by_mac(eth_mac(0, 1)), 1u);
    EXPECT_EQ(hxal_adapter_get_by_mac(fcoe_mac(0, 1)), 0u);
    EXPECT_EQ(hxal_adapter_open_by_wwn(0), 0);
}

} // namespace
