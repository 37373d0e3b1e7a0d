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
