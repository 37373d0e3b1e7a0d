#include "tests/hxal/golden.h"
#include "tests/hxal/library_fixture.h"

#include <cerrno>

namespace
{

using Scan = Library_Test;

TEST_F(Scan, of_a_converged_adapter_sends_these_requests_and_no_others)
{
    host(one_cna);
    ASSERT_EQ(hxal_adapter_scan(), 1);

    const auto sent = hxasim::take_requests();
    std::string lines;
    for (const auto& request : sent)
    {
        char line[128];
        std::snprintf(line, sizeof line, "%s %08lX %s %d\n", request.node.c_str(), request.command, request.name.c_str(),
                      request.instance);
        lines += line;
    }
    EXPECT_EQ(lines, golden("scan.txt"));

    for (const auto& request : sent)
    {
        std::vector<std::uint8_t> record(request.sent.size());
        if (request.name == "IOCMD_AEN_SYNC")
            record[8] = hxa_aen_app_cim;
        else if (request.instance == 1)
            record[4] = 1;
        EXPECT_EQ(request.sent, record) << request.name;
    }
}

TEST_F(Scan, fills_a_handle_with_what_its_type_has)
{
    host(R"({"adapters": [{"kind": "cna", "ports": [{
        "pwwn": "1000000000000001", "nwwn": "2000000000000002",
        "factory_pwwn": "1000000000000003", "factory_nwwn": "2000000000000004",
        "mac": "000000000005", "factory_mac": "000000000006", "current_mac": "000000000007",
        "fcoe_mac": "000000000008", "fcoe_factory_mac": "000000000009"}]}]})");
    ASSERT_EQ(hxal_ioc_scan(), 2);
    const auto last = [](wwn_t wwn) { return reinterpret_cast<const uint8_t*>(&wwn)[7]; };

    const hxal_t* fcoe = hxal_ioc_open_idx(0);
    EXPECT_THAT((std::vector{last(fcoe->pwwn), last(fcoe->nwwn), last(fcoe->factorypwwn), last(fcoe->factorynwwn)}),
                testing::ElementsAre(1, 2, 3, 4));
    EXPECT_EQ(fcoe->mac.mac[5], 8);
    EXPECT_EQ(fcoe->factory_mac.mac[5], 9);
    EXPECT_EQ(hxal_ioc_get_factory_mac(fcoe).mac[5], 9);
    EXPECT_STREQ(fcoe->eth_name, "");

    const hxal_t* ethernet = hxal_ioc_open_idx(1);
    EXPECT_EQ(ethernet->factorypwwn | ethernet->factorynwwn, 0u);
    EXPECT_EQ(ethernet->mac.mac[5], 5);
    EXPECT_EQ(ethernet->factory_mac.mac[5], 6);
    EXPECT_EQ(ethernet->current_mac.mac[5], 7);
    EXPECT_STREQ(ethernet->eth_name, "eth0");
}

TEST_F(Scan, asks_for_the_instances_of_the_bitmap)
{
    host(R"({"adapters": [{"kind": "fc-hba", "ports": [{"fc_instance": 1}, {"fc_instance": 7}, {"fc_instance": 8},
                                                       {"fc_instance": 14}, {"fc_instance": 127}]}]})");
    EXPECT_EQ(hxal_ioc_scan(), 128);
    std::vector<int> instances;
    for (const hxal_t* ioc = hxal_ioc_get_list(); ioc; ioc = ioc->next)
        instances.push_back(ioc->instance);
    EXPECT_THAT(instances, testing::ElementsAre(1, 7, 8, 14, 127));
}

// What may go wrong on one node, and the last error that it leaves.
struct Failure
{
    const char* what;
    const char* driver; // of the scenario
    const char* command;
    int error;
    uint32_t status;
    hxa_status_t last_error;
};

// clang-format off
const Failure failures[] = {
    {"no node",              R"({"present": false})",           "",                      0,      0,  HXA_STATUS_NO_DRIVER},
    {"version refused",      R"({"version_status": 70})",       "",                      0,      0,  HXA_STATUS_VERSION_FAIL},
    {"version request",      "{}",                              "IOCMD_IOC_GET_VERSION", ENOTTY, 0,  HXA_STATUS_EIO},
    {"instance request",     "{}",                              "IOCMD_IOC_GET_INST",    EINTR,  0,  HXA_STATUS_EIO},
    {"129 instances",        R"({"instance_count": 129})",      "",                      0,      0,  HXA_STATUS_EIO},
    {"2^32-1 instances",     R"({"instance_count": 4294967295})", "",                    0,      0,  HXA_STATUS_EIO},
    {"event synchronisation","{}",                              "IOCMD_AEN_SYNC",        EINVAL, 0,  HXA_STATUS_EIO},
    {"information request",  "{}",                              "IOCMD_IOC_GET_INFO",    ENXIO,  0,  HXA_STATUS_EIO},
    {"information refused",  "{}",                              "IOCMD_IOC_GET_INFO",    0,      61, HXA_STATUS_IOC_NON_OP},
};
// clang-format on

TEST_F(Scan, of_a_failing_node_adds_nothing_while_the_other_node_serves)
{
    for (const std::string node : {"hxa", "hxn"})
        for (const Failure& failure : failures)
        {
            SCOPED_TRACE(node + ": " + failure.what);
            host(R"({"adapters": [{"kind": "cna"}], "drivers": {")" + node + "\": " + failure.driver + "}}");
            hxasim::Fault fault{
                .command = failure.command, .node = "/dev/" + node, .error = failure.error, .status = failure.status};
            if (fault.command == "IOCMD_IOC_GET_INFO") // the first IOC is listed already when the second one fails
                fault.instance = 1;
            if (!fault.command.empty())
                hxasim::inject(fault);

            hxal_set_last_error(HXA_STATUS_OK);
            ASSERT_EQ(hxal_adapter_scan(), 1);
            EXPECT_EQ(hxal_get_last_error(), failure.last_error);
            EXPECT_EQ(hxal_ioc_get_num(), 2);
            ASSERT_NE(hxal_ioc_open_idx(0), nullptr);
            EXPECT_EQ(hxal_ioc_open_idx(0)->ioc_type, node == "hxa" ? HXA_IOC_TYPE_LL : HXA_IOC_TYPE_FCoE);
            EXPECT_EQ(hxasim::open_descriptors(), 1);
        }
}

TEST_F(Scan, without_any_driver_leaves_the_later_node_s_error)
{
    EXPECT_EQ(scan(R"({"drivers": {"hxa": {"present": false}, "hxn": {"version_status": 70}}})"), 0);
    EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_VERSION_FAIL);
    EXPECT_EQ(hxal_ioc_get_inst_num(), -1);
}

TEST_F(Scan, warns_of_another_driver_version_and_goes_on)
{
    host(R"({"adapters": [{"kind": "cna"}], "drivers": {"hxa": {"version": 4129}}})");
    testing::internal::CaptureStdout();
    EXPECT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "\nWARNING: Tessik and Driver versions dont match!!!\n\n");
    EXPECT_EQ(hxal_ioc_get_num(), 4);
}

TEST_F(Scan, that_finds_a_hole_lists_the_iocs_and_no_adapter)
{
    host(R"({"adapters": [{"kind": "cna", "ports": [{"fc_instance": 0, "eth_instance": 0}, {"fc_instance": 2}]}]})");
    ASSERT_EQ(hxal_ioc_scan(), 5);
    EXPECT_EQ(hxal_ioc_open_idx(1)->instance, 2);
    EXPECT_EQ(hxal_ioc_open_idx(2), nullptr);
    EXPECT_EQ(hxal_ioc_open_idx(3)->ioc_type, HXA_IOC_TYPE_LL);

    hxal_set_last_error(HXA_STATUS_DIAG_BUSY);
    hxasim::take_requests();
    EXPECT_EQ(hxal_adapter_scan(), 0);
    const auto sent = commands();
    EXPECT_EQ(std::count(sent.begin(), sent.end(), "IOCMD_IOC_GET_ATTR"), 2) << "those behind the hole are not asked";
    EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_DIAG_BUSY);
    EXPECT_EQ(hxal_adapter_get_num(), 0u);
}

TEST_F(Scan, of_adapters_stops_at_a_failing_ioc_and_forgets_the_earlier_adapters)
{
    struct Case
    {
        hxasim::Fault fault;
        hxa_status_t last_error;
    };
    const Case cases[] = {
        {{.command = "IOCMD_IOC_GET_ATTR", .node = "/dev/hxn", .error = ENXIO}, HXA_STATUS_ENXIO},
        {{.command = "IOCMD_IOC_GET_ATTR", .instance = 1, .status = 61}, HXA_STATUS_IOC_NON_OP},
        {{.command = "IOCMD_IOC_GET_INFO", .error = ENODEV, .skip = 4}, HXA_STATUS_NODEV},
        {{.command = "IOCMD_IOC_GET_INFO", .status = 3, .skip = 7}, HXA_STATUS_ENOMEM},
    };
    for (const Case& each : cases)
    {
        ASSERT_EQ(scan(one_cna), 1);
        hxasim::inject(each.fault);
        testing::internal::CaptureStdout();
        EXPECT_EQ(hxal_adapter_scan(), 0);
        testing::internal::GetCapturedStdout();
        EXPECT_EQ(hxal_get_last_error(), each.last_error);
        EXPECT_EQ(hxal_adapter_get_num(), 0u);
        EXPECT_EQ(hxal_adapter_get_by_idx(1), nullptr);
        EXPECT_EQ(hxal_ioc_get_num(), 4);
    }
}

TEST_F(Scan, keeps_one_descriptor_for_each_node_that_a_list_uses)
{
    host(one_cna);
    for (int i = 0; i < 100; ++i)
        ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxasim::open_descriptors(), 2);

    for (int i = 0; i < 3; ++i) // the adapters stay usable
        ASSERT_EQ(hxal_ioc_scan(), 4);
    EXPECT_EQ(hxasim::open_descriptors(), 4);
    hxa_pport_attr_t attr;
    EXPECT_EQ(hxal_port_get_attr(hxal_adapter_get_ioc(hxal_adapter_open_idx(1), 0), &attr), HXA_STATUS_OK);

    hxal_adapter_scan();
    EXPECT_EQ(hxasim::open_descriptors(), 2);
    EXPECT_EQ(scan("{}"), 0);
    EXPECT_EQ(hxasim::open_descriptors(), 0);
}

TEST_F(Scan, leaves_a_registration_its_descriptor_until_it_is_taken_back)
{
    ASSERT_EQ(scan(one_cna), 1);
    const auto ignore = [](void*, uint32_t, const hxa_ioc_aen_data_t*, hxa_timeval_t) {};
    hxal_ioc_aen_cbhandle_t* registration = nullptr;
    ASSERT_EQ(hxal_ioc_aen_register(hxal_ioc_open_idx(0), ignore, nullptr, &registration), HXA_STATUS_OK);
    for (int i = 0; i < 3; ++i)
        ASSERT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxasim::open_descriptors(), 3);
    scan("{}");
    EXPECT_EQ(hxasim::open_descriptors(), 1);
    EXPECT_EQ(hxal_ioc_aen_unregister(registration), HXA_STATUS_OK);
    EXPECT_EQ(hxasim::open_descriptors(), 0);
}

TEST_F(Scan, of_iocs_alone_can_hand_its_descriptor_to_an_adapter)
{
    scan(R"({"adapters": [{"kind": "cna", "ports": [{}]}]})");
    hxal_ioc_scan();
    hxal_adapter_t* ad = hxal_adapter_open_idx(1);
    for (int idx : {0, 1})
    {
        hxal_t* ioc = hxal_ioc_open_idx(idx);
        hxal_t* copy = idx == 0 ? ad->fcioc_list : ad->ethioc_list;
        EXPECT_NE(copy->fd, ioc->fd);
        hxal_adapter_update_ioc(1, ioc);
        EXPECT_EQ(copy->fd, ioc->fd);
    }
    EXPECT_EQ(hxasim::open_descriptors(), 2);
    hxal_ioc_scan();
    hxa_pport_attr_t attr;
    EXPECT_EQ(hxal_port_get_attr(ad->fcioc_list, &attr), HXA_STATUS_OK);
    hxal_adapter_update_ioc(1, ad->fcioc_list);
    EXPECT_EQ(hxal_port_get_attr(ad->fcioc_list, &attr), HXA_STATUS_OK);

    hxal_adapter_update_ioc(2, hxal_ioc_open_idx(0));
    hxal_adapter_update_ioc(1, nullptr);
}

} // namespace
