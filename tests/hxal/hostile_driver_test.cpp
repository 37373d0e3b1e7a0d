#include "simulated_host.h"

namespace
{

class Hostile_Driver : public Simulated_Host
{
protected:
    static constexpr std::size_t port_id = offsetof(hxa_ioctl_ioc_attr_t, attr) + offsetof(hxa_ioc_attr_t, port_id);
    static constexpr std::size_t pcifn = offsetof(hxa_ioctl_ioc_attr_t, attr) + offsetof(hxa_ioc_attr_t, pci_attr.pcifn);
    static constexpr std::size_t model_descr =
        offsetof(hxa_ioctl_ioc_attr_t, attr) + offsetof(hxa_ioc_attr_t, adapter_attr.model_descr);
    static constexpr std::size_t info_name = offsetof(hxa_ioctl_ioc_info_t, name);
};

TEST_F(Hostile_Driver, that_ends_no_text_is_cut_at_the_field)
{
    host(R"({"adapters": [{"kind": "cna", "ports": [{}]}]})");
    distort("IOCMD_IOC_GET_INFO", 8, std::vector<std::uint8_t>(448, 'x'), {}, "");
    distort("IOCMD_IOC_GET_ATTR", model_descr, std::vector<std::uint8_t>(128, 'y'));
    ASSERT_EQ(hxal_adapter_scan(), 1);

    const hxal_t* ioc = hxal_ioc_open_idx(1);
    EXPECT_EQ(std::strlen(ioc->serialnum), 11u);
    EXPECT_EQ(std::strlen(ioc->ioc_hwpath), 31u);
    EXPECT_EQ(std::strlen(ioc->adapter_hwpath), 31u);
    EXPECT_EQ(std::strlen(ioc->name), 63u);
    EXPECT_EQ(std::strlen(ioc->port_name), 63u);
    EXPECT_EQ(std::strlen(ioc->eth_name), 63u);
    EXPECT_EQ(std::strlen(hxal_adapter_open_idx(1)->model_descr), 127u);
    EXPECT_EQ(std::strlen(hxal_adapter_get_name(1)), 63u);
}

TEST_F(Hostile_Driver, that_invents_an_ioc_type_is_taken_for_the_type_of_its_node)
{
    host(R"({"adapters": [{"kind": "cna", "ports": [{}]}]})");
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, ioc_type), {0xFF, 0xFF, 0xFF, 0xFF}, {}, "");
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxal_ioc_open_idx(0)->ioc_type, HXA_IOC_TYPE_FC);
    EXPECT_EQ(hxal_ioc_open_idx(1)->ioc_type, HXA_IOC_TYPE_LL);
}

TEST_F(Hostile_Driver, that_counts_ports_up_to_255_is_followed_there)
{
    host(R"({"adapters": [{"kind": "fc-hba"}]})");
    distort("IOCMD_IOC_GET_ATTR", port_id, {255}, 1);
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxal_adapter_get_num_port(1), 256);
    EXPECT_EQ(hxal_adapter_get_ioc_idx_by_pwwn(1, port_wwn(0, 1)), 255);
    EXPECT_EQ(hxal_adapter_is_enabled(1), HXA_TRUE);
}

TEST_F(Hostile_Driver, that_lists_ports_backwards_is_searched_from_port_0)
{
    host(R"({"adapters": [{"kind": "cna"}]})");
    const std::vector<std::uint8_t> same_wwn(8, 0x20);
    distort("IOCMD_IOC_GET_ATTR", port_id, {1}, 0);
    distort("IOCMD_IOC_GET_ATTR", port_id, {0}, 1);
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, nwwn), same_wwn);
    ASSERT_EQ(hxal_adapter_scan(), 1);

    const hxal_adapter_t* ad = hxal_adapter_open_idx(1);
    EXPECT_EQ(ad->port_count, 2);
    EXPECT_EQ(hxal_adapter_get_first_ioc(ad)->instance, 1);
    EXPECT_EQ(hxal_adapter_get_ioc_idx_by_pwwn(1, 0x2020202020202020), 0);
}

TEST_F(Hostile_Driver, that_gives_one_path_to_both_functions_shows_the_lower_port)
{
    host(R"({"adapters": [{"kind": "cna"}]})");
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, hwpath), {'p', 0}, 1, "/dev/hxa");
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, hwpath), {'p', 0}, 0, "/dev/hxn");
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxal_adapter_get_ioc_idx_by_hwpath(1, "p"), 0);
}

TEST_F(Hostile_Driver, that_puts_two_iocs_on_one_port_shows_the_first)
{
    host(R"({"adapters": [{"kind": "fc-hba"}]})");
    distort("IOCMD_IOC_GET_ATTR", port_id, {0}, 1);
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxal_adapter_get_num_ioc(1), 2);
    EXPECT_EQ(hxal_adapter_get_num_port(1), 1);
    EXPECT_EQ(hxal_adapter_get_fcioc(hxal_adapter_open_idx(1), 0)->instance, 0);
    EXPECT_EQ(hxal_adapter_get_ioc_idx_by_pwwn(1, port_wwn(0, 1)), -1);
}

TEST_F(Hostile_Driver, that_starts_with_another_port_names_the_adapter_through_function_0)
{
    host(R"({"adapters": [{"kind": "fc-hba", "ports": [{}, {}, {}]}]})");
    distort("IOCMD_IOC_GET_ATTR", port_id, {9}, 0);
    distort("IOCMD_IOC_GET_ATTR", pcifn, {0}, 1);
    distort("IOCMD_IOC_GET_INFO", info_name, {'A', 0}, 0);
    distort("IOCMD_IOC_GET_INFO", info_name, {'B', 0}, 1);
    distort("IOCMD_IOC_GET_INFO", info_name, {'C', 0}, 2);
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_STREQ(hxal_adapter_open_idx(1)->name, "B");
    EXPECT_EQ(hxal_adapter_get_num_port(1), 10);
}

} // namespace
