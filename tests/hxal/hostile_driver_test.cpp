// A driver that lies: whatever it answers, the library neither crashes nor hangs nor grows.
#include "allocations.h"
#include "boot_files.h"
#include "hxal/records/commands.h"
#include "operation_table.h"
#include "tests/hxal/library_fixture.h"

#include <algorithm>
#include <cstddef>
#include <random>
#include <sys/mman.h>

namespace
{

constexpr std::size_t memory_limit = 64 << 20;

class Hostile_Driver : public Library_Test
{
protected:
    Hostile_Driver() { allocations::reset_peak(); }
    ~Hostile_Driver() override { EXPECT_LE(allocations::peak(), memory_limit); }

    // From here on every answer is random; most of them keep the status and the instances, so that the scan goes on.
    void answer_random_bytes()
    {
        hxasim::clear_faults();
        for (const hxal::Command& command : hxal::catalogue)
            for (const std::optional<int> instance : {std::optional(0), std::optional(1), std::optional<int>()})
                answer_random_bytes(command, instance);
    }

    void answer_random_bytes(const hxal::Command& command, std::optional<int> instance)
    {
        const std::size_t kept = random() % 8 == 0 ? 0 : command.name == "IOCMD_IOC_GET_INST" ? 9 : 8;
        std::vector<std::uint8_t> bytes(command.size - kept);
        std::generate(bytes.begin(), bytes.end(), [this] { return static_cast<std::uint8_t>(random()); });
        if (!bytes.empty())
            hxasim::inject({.command = std::string(command.name), .instance = instance, .answer = {{kept, std::move(bytes)}}});
    }

    // Operations of several requests, or that convert what they get.
    static void use_compositions(hxal_t* ioc)
    {
        const wwn_t remote = port_wwn(7, 7);
        hxal_port_enable(ioc);
        hxal_port_disable(ioc);
        hxal_diag_beacon_lport(ioc, HXA_TRUE, 0);
        hxal_stats_long_t long_counters[45];
        hxal_port_get_stats(ioc, long_counters);
        hxal_fcoe_get_stats(ioc, long_counters);
        hxal_stats_t counters[43];
        hxal_lport_get_stats(ioc, 0, ioc->pwwn, counters);
        hxa_rport_attr_t attr;
        hxal_rport_get_attr(ioc, 0, 0, remote, &attr);
        hxa_rport_symname_t symname;
        hxal_get_rport_symname(ioc, 0, 1, ioc->pwwn, remote, &symname);
        char bytes[16];
        hxal_flash_read_part(ioc, HXA_FLASH_PART_VPD, 0, bytes, sizeof bytes, HXA_FALSE);
        const unsigned char image[16] = {};
        hxal_flash_update_part(ioc, HXA_FLASH_PART_FWIMG, 0, image, HXA_FALSE, sizeof image);
        hxal_boot_fwupdate(ioc, boot_archive(), 0x13);
        hxa_aen_entry_t events[HXA_AEN_MAX_ENTRIES];
        int count = HXA_AEN_MAX_ENTRIES;
        hxal_aen_get_events(ioc, events, &count, hxa_aen_app_cim);
    }

    // The path of an archive that lies in no folder.
    static const char* boot_archive()
    {
        static const std::string path = []
        {
            std::string memory = "/proc/self/fd/" + std::to_string(::memfd_create("archive", MFD_CLOEXEC));
            Archive()
                .add("boot.txt", bytes_of("IMAGE\nTYPE=O\nID=13\nIMAGE\nPORT=0,1\nTYPE=C\nID=13\n"))
                .add("optrom.bin", Rom{}.build())
                .add("config.bin", bytes_of("configuration"))
                .save(memory);
            return memory;
        }();
        return path.c_str();
    }

    static void use_operations(hxal_t* ioc)
    {
        for (const Operation& operation : operations())
        {
            alignas(std::max_align_t) std::uint8_t output[4096] = {};
            operation.call(ioc, output);
        }
    }

    static void use_adapter(int ad)
    {
        hxal_adapter_get_name(static_cast<unsigned>(ad));
        hxal_adapter_set_name(static_cast<unsigned>(ad), "green");
        hxal_adapter_set_power(hxal_adapter_open_idx(ad), HXA_PM_DS_D1);
        hxal_adapter_enable(ad);
        hxal_adapter_disable(ad);
        for (int port = 0; port < hxal_adapter_get_num_port(ad); ++port)
        {
            hxal_t* ioc = hxal_adapter_get_ioc(hxal_adapter_open_idx(ad), port);
            if (!ioc)
                continue;
            use_operations(ioc);
            use_compositions(ioc);
            hxal_ioc_get_current_mac(ioc);
        }
        const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
        EXPECT_EQ(hxal_adapter_lookup(adapter->serial_num)->id, ad);
        EXPECT_LT(strnlen(adapter->model_descr, sizeof adapter->model_descr), sizeof adapter->model_descr);
    }

    std::minstd_rand random{1};
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
    EXPECT_STREQ(hxal_ioc_get_sn(ioc), "xxxxxxxxxxxx");
    for (const char* path : {ioc->ioc_hwpath, ioc->adapter_hwpath})
        EXPECT_EQ(std::strlen(path), 31u);
    for (const char* name : {ioc->name, ioc->port_name, ioc->eth_name, static_cast<const char*>(hxal_adapter_get_name(1))})
        EXPECT_EQ(std::strlen(name), 63u);
    EXPECT_EQ(std::strlen(hxal_adapter_open_idx(1)->model_descr), 127u);
}

TEST_F(Hostile_Driver, that_answers_random_bytes_breaks_nothing)
{
    host(one_cna);
    testing::internal::CaptureStdout();
    int scans_with_adapters = 0;
    for (int round = 0; round < 300; ++round)
    {
        answer_random_bytes();
        const int count = hxal_adapter_scan();
        for (int ad = 1; ad <= count; ++ad)
            use_adapter(ad);
        scans_with_adapters += count > 0;
        EXPECT_LE(hxasim::open_descriptors(), 2);
        hxasim::take_requests(); // the simulator's memory is not the library's
    }
    testing::internal::GetCapturedStdout();
    EXPECT_GT(scans_with_adapters, 30);
}

TEST_F(Hostile_Driver, that_invents_an_ioc_type_is_taken_for_the_type_of_its_node)
{
    host(R"({"adapters": [{"kind": "cna", "ports": [{}]}]})");
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, ioc_type), {0xFF, 0xFF, 0xFF, 0xFF}, {}, "");
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxal_ioc_open_idx(0)->ioc_type, HXA_IOC_TYPE_FC);
    EXPECT_EQ(hxal_ioc_open_idx(1)->ioc_type, HXA_IOC_TYPE_LL);
}

TEST_F(Hostile_Driver, that_puts_the_second_ioc_on_another_port_is_followed_there_unless_the_port_is_taken)
{
    const struct
    {
        std::uint8_t port;
        int ports, found;
    } rows[] = {{255, 256, 255}, {0, 1, -1}};
    for (const auto& [port, ports, found] : rows)
    {
        host(R"({"adapters": [{"kind": "fc-hba"}]})");
        distort("IOCMD_IOC_GET_ATTR", port_id, {port}, 1);
        ASSERT_EQ(hxal_adapter_scan(), 1);
        EXPECT_EQ(hxal_adapter_get_num_ioc(1), 2);
        EXPECT_EQ(hxal_adapter_get_num_port(1), ports);
        EXPECT_EQ(hxal_adapter_get_fcioc(hxal_adapter_open_idx(1), 0)->instance, 0);
        EXPECT_EQ(hxal_adapter_get_ioc_idx_by_pwwn(1, port_wwn(0, 1)), found);
        EXPECT_EQ(hxal_adapter_is_enabled(1), HXA_TRUE);
    }
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

TEST_F(Hostile_Driver, that_puts_all_iocs_of_both_nodes_on_one_path_makes_one_adapter)
{
    host(R"({"generate": {"adapters": 16, "ports": 8, "kind": "cna"}})");
    distort("IOCMD_IOC_GET_INFO", offsetof(hxa_ioctl_ioc_info_t, adapter_hwpath), {'p', 0}, {}, "");
    ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxal_adapter_get_num_ioc(1), 256);
    EXPECT_EQ(hxal_adapter_get_num_port(1), 8);
    EXPECT_EQ(hxal_adapter_is_enabled(1), HXA_TRUE);
    EXPECT_EQ(hxal_adapter_disable(1), HXA_STATUS_OK);
    EXPECT_EQ(hxal_adapter_is_disabled(1), HXA_TRUE);
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
