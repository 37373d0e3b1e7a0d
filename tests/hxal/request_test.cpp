#include "simulated_host.h"

#include <cerrno>

namespace
{

class Request : public Simulated_Host
{
protected:
    Request()
    {
        host(one_cna);
        hxal_ioc_scan();
        hxasim::take_requests();
        fcoe = hxal_ioc_open_idx(1);
        ethernet = hxal_ioc_open_idx(3);
    }

    hxal_t* fcoe = nullptr;
    hxal_t* ethernet = nullptr;
};

TEST_F(Request, carries_the_instance_under_the_group_byte_of_the_ioc_type)
{
    hxa_pport_attr_t attr;
    ASSERT_EQ(hxal_port_get_attr(fcoe, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.pwwn, port_wwn(0, 1));
    ASSERT_EQ(hxal_port_get_attr(ethernet, &attr), HXA_STATUS_OK);

    const auto sent = hxasim::take_requests();
    ASSERT_EQ(sent.size(), 2u);
    std::vector<std::uint8_t> record(376);
    record[4] = 1;
    EXPECT_EQ(sent[0].node, "/dev/hxa");
    EXPECT_EQ(sent[0].command, 0xC178432Du);
    EXPECT_EQ(sent[0].sent, record);
    EXPECT_EQ(sent[1].node, "/dev/hxn");
    EXPECT_EQ(sent[1].command, 0xC178442Du);
    EXPECT_EQ(sent[1].sent, record);
}

TEST_F(Request, that_fails_answers_the_status_of_errno_once_and_leaves_the_buffer_alone)
{
    const std::pair<int, hxa_status_t> cases[] = {
        {EINTR, HXA_STATUS_EINTR},   {EIO, HXA_STATUS_EIO},       {ENXIO, HXA_STATUS_ENXIO},
        {EBADF, HXA_STATUS_EBADF},   {ENODEV, HXA_STATUS_NODEV},  {EINVAL, HXA_STATUS_EINVAL},
        {ENOTTY, HXA_STATUS_ENOTTY}, {EAGAIN, HXA_STATUS_FAILED}, {ENOMEM, HXA_STATUS_FAILED},
    };
    for (const auto& [error, status] : cases)
        for (hxal_t* ioc : {fcoe, ethernet})
        {
            hxasim::clear_faults();
            fail("IOCMD_PORT_GET_ATTR", error);
            hxa_pport_attr_t attr{};
            attr.port_state = 77;
            EXPECT_EQ(hxal_port_get_attr(ioc, &attr), status) << error;
            EXPECT_EQ(attr.port_state, 77u);
            EXPECT_EQ(requests().size(), 1u);
        }
    EXPECT_EQ(hxal_get_status(0), HXA_STATUS_FAILED);
}

TEST_F(Request, that_the_driver_refuses_answers_its_status_and_fills_the_buffer)
{
    distort("IOCMD_PORT_GET_ATTR", 0, {0xEF, 0xBE, 0xAD, 0xDE});
    hxa_pport_attr_t attr{};
    EXPECT_EQ(static_cast<uint32_t>(hxal_port_get_attr(fcoe, &attr)), 0xDEADBEEFu);
    EXPECT_EQ(attr.pwwn, port_wwn(0, 1));
    EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_OK);
}

TEST_F(Request, for_ioc_attributes_tells_its_failure)
{
    hxa_ioc_attr_t attr;
    ASSERT_EQ(hxal_ioc_get_attr(fcoe, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.state, uint32_t{HXA_IOC_OPERATIONAL});
    EXPECT_EQ(attr.port_id, 1);

    fail("IOCMD_IOC_GET_ATTR", ENXIO);
    testing::internal::CaptureStdout();
    EXPECT_EQ(hxal_ioc_get_attr(fcoe, &attr), HXA_STATUS_ENXIO);
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "IOCTL ERR  IOCMD_IOC_GET_ATTR   No such device or address\n");
}

TEST_F(Request, without_a_handle_or_a_buffer_is_not_sent)
{
    hxa_ioctl_ioc_info_t info;
    hxa_ioc_attr_t ioc_attr;
    hxa_pport_attr_t port_attr;
    EXPECT_EQ(hxal_ioc_compare_versions(nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_ioc_get_info(nullptr, &info), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_ioc_get_info(fcoe, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_ioc_get_attr(nullptr, &ioc_attr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_ioc_get_attr(fcoe, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_port_get_attr(nullptr, &port_attr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_port_get_attr(fcoe, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_ioc_get_current_mac(nullptr).mac[5], 0);
    EXPECT_THAT(requests(), testing::IsEmpty());
}

TEST_F(Request, for_the_current_mac_refreshes_the_handle_unless_it_fails)
{
    constexpr std::size_t current_mac = offsetof(hxa_ioctl_ioc_info_t, current_mac);
    distort("IOCMD_IOC_GET_INFO", current_mac, {1, 2, 3, 4, 5, 6}, 1, "/dev/hxn");
    EXPECT_EQ(hxal_ioc_get_current_mac(ethernet).mac[5], 6);
    EXPECT_EQ(ethernet->current_mac.mac[5], 6);
    EXPECT_EQ(ethernet->mac.mac[5], 1);

    hxasim::clear_faults();
    fail("IOCMD_IOC_GET_INFO", EIO);
    EXPECT_EQ(hxal_ioc_get_current_mac(ethernet).mac[5], 6);
}

} // namespace
