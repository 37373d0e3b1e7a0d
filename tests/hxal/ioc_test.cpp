#include "tests/hxal/library_fixture.h"

#include <cerrno>

namespace
{

using testing::ElementsAre;

// Indexes: 0 FC (one-port HBA), 1 and 2 FCoE, 3 and 4 Ethernet.
class Ioc : public Library_Test
{
protected:
    Ioc()
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "name": "red", "hwpath": "0000:01:00", "ports": [{"name": "r0"}]},
                              {"kind": "cna", "name": "blue", "hwpath": "0000:02:00", "serial": "ABC",
                               "ports": [{"name": "b0"}, {"name": "b1"}]}]})");
    }
    ~Ioc() override { EXPECT_THAT(commands(), testing::IsEmpty()); }

    static int id(const hxal_t* ioc) { return ioc ? ioc->id : -1; }
};

TEST_F(Ioc, is_found_by_index_address_name_path_and_instance)
{
    const int handles[] = {id(hxal_ioc_open_idx(4)),
                           id(hxal_ioc_open_pwwn(port_wwn(1, 1))),
                           id(hxal_ioc_open_name("blue")),
                           id(hxal_ioc_open_hwpath("0000:02:00.3")),
                           id(hxal_ioc_get_by_eth_name("eth1")),
                           id(hxal_ioc_get_by_inst(1))};
    EXPECT_THAT(handles, ElementsAre(4, 2, 1, 4, 4, 1));
    const int by_address[] = {hxal_ioc_get_idx_by_pwwn(port_wwn(0, 0)), hxal_ioc_get_idx_by_mac(fcoe_mac(1, 1)),
                              hxal_ioc_get_idx_by_mac(eth_mac(1, 0)), hxal_ioc_get_inst_num_by_pwwn(port_wwn(1, 1)),
                              hxal_ioc_get_inst_num_by_mac(eth_mac(1, 1))};
    EXPECT_THAT(by_address, ElementsAre(0, 2, 3, 2, 1));
    const int by_text[] = {hxal_ioc_get_fc_idx_by_name("r0"),
                           hxal_ioc_get_fc_idx_by_name("b1"),
                           hxal_ioc_get_eth_idx_by_name("b1"),
                           hxal_ioc_get_idx_by_name("b1", HXA_IOC_TYPE_FCoE),
                           hxal_ioc_get_fc_idx_by_hwpath("0000:02:00.0"),
                           hxal_ioc_get_eth_idx_by_hwpath("0000:02:00.2")};
    EXPECT_THAT(by_text, ElementsAre(0, 2, 4, 2, 1, 3));
}

TEST_F(Ioc, is_not_found_by_what_nobody_or_another_kind_has)
{
    const hxal_t* const handles[] = {hxal_ioc_open_idx(-1),       hxal_ioc_open_idx(5),
                                     hxal_ioc_open_idx(INT_MAX),  hxal_ioc_open_name("Blue"),
                                     hxal_ioc_open_name(nullptr), hxal_ioc_open_hwpath(nullptr),
                                     hxal_ioc_get_by_inst(3),     hxal_ioc_get_by_eth_name(nullptr)};
    EXPECT_THAT(handles, testing::Each(nullptr));
    EXPECT_EQ(hxal_ioc_open_pwwn(0), nullptr) << "the Ethernet IOCs' own";
    EXPECT_EQ(hxal_ioc_get_idx_by_mac(mac_t{}), -1) << "the FC IOC's own";
    const int numbers[] = {hxal_ioc_get_idx_by_pwwn(node_wwn(1, 1)),
                           hxal_ioc_get_idx_by_mac(mac_t{{1}}),
                           hxal_ioc_get_idx_by_name("r0", HXA_IOC_TYPE_FCoE),
                           hxal_ioc_get_eth_idx_by_name("r0"),
                           hxal_ioc_get_fc_idx_by_name(nullptr),
                           hxal_ioc_get_fc_idx_by_hwpath("0000:02:00.2"),
                           hxal_ioc_get_eth_idx_by_hwpath(nullptr),
                           hxal_ioc_get_inst_num_by_pwwn(0),
                           hxal_ioc_get_inst_num_by_mac(fcoe_mac(1, 0))};
    EXPECT_THAT(numbers, testing::Each(-1));
}

TEST_F(Ioc, tells_its_paths_and_of_nobody_nothing)
{
    char devpath[256], hwpath[32], adapter_hwpath[32];
    hxal_ioc_get_path(hxal_ioc_open_idx(4), devpath, hwpath, adapter_hwpath);
    EXPECT_STREQ(devpath, "/dev/hxn");
    EXPECT_STREQ(hwpath, "0000:02:00.3");
    EXPECT_STREQ(adapter_hwpath, "0000:02:00");
    hxal_ioc_get_path_by_idx(0, devpath);
    EXPECT_STREQ(devpath, "/dev/hxa");
    hxal_ioc_get_path_by_idx(5, devpath);
    EXPECT_STREQ(devpath, "/dev/hxa");
    EXPECT_EQ(hxal_ioc_get_name(hxal_ioc_open_idx(4)), std::string("b1"));
    EXPECT_EQ(hxal_ioc_get_mac(hxal_ioc_open_idx(0)).mac[1], 0) << "an FC IOC has none";

    EXPECT_EQ(hxal_ioc_get_name(nullptr), nullptr);
    EXPECT_EQ(hxal_ioc_get_pwwn(nullptr), 0u);
    EXPECT_EQ(hxal_ioc_get_port_num(nullptr), -1);
    EXPECT_EQ(int{hxal_ioc_get_ioc_type(nullptr)}, 0);
    hxal_ioc_get_path(nullptr, devpath, hwpath, adapter_hwpath);
    hxal_ioc_close(nullptr);
}

TEST_F(Ioc, refreshes_its_current_mac_unless_the_request_fails)
{
    hxal_t* ethernet = hxal_ioc_open_idx(3);
    const mac_t own = ethernet->mac;
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, current_mac), {1, 2, 3, 4, 5, 6}, 0, "/dev/hxn");
    EXPECT_EQ(hxal_ioc_get_current_mac(ethernet).mac[5], 6);
    EXPECT_EQ(ethernet->current_mac.mac[5], 6);
    EXPECT_EQ(std::memcmp(&ethernet->mac, &own, sizeof own), 0);

    hxasim::clear_faults();
    fail("IOCMD_IOC_GET_INFO", EIO);
    EXPECT_EQ(hxal_ioc_get_current_mac(ethernet).mac[5], 6);
    EXPECT_EQ(commands().size(), 2u);
}

} // namespace
