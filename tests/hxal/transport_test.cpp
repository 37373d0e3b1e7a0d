// What counts as a failed call. This program answers ioctl itself, with return values that a well-bred driver never gives.
#include "hxal/hxal.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <sys/ioctl.h>

namespace
{

int ioctl_result = 0;

} // namespace

int ioctl(int, unsigned long, ...) noexcept { return ioctl_result; }

TEST(Transport, any_number_but_0_fails_on_ethernet_and_only_minus_1_elsewhere)
{
    struct Case
    {
        hxa_ioc_type_e type;
        int result;
        hxa_status_t status;
    };
    const Case cases[] = {
        {HXA_IOC_TYPE_FC, 0, HXA_STATUS_OK},     {HXA_IOC_TYPE_FC, -1, HXA_STATUS_FAILED}, {HXA_IOC_TYPE_FC, 5, HXA_STATUS_OK},
        {HXA_IOC_TYPE_FCoE, 5, HXA_STATUS_OK},   {HXA_IOC_TYPE_FCoE, -2, HXA_STATUS_OK},   {HXA_IOC_TYPE_LL, 0, HXA_STATUS_OK},
        {HXA_IOC_TYPE_LL, 5, HXA_STATUS_FAILED}, {HXA_IOC_TYPE_LL, -1, HXA_STATUS_FAILED},
    };
    for (const Case& each : cases)
    {
        hxal_t ioc{};
        ioc.ioc_type = each.type;
        ioctl_result = each.result;
        errno = EINVAL; // of an earlier call: it must not show through
        hxa_pport_attr_t attr;
        EXPECT_EQ(hxal_port_get_attr(&ioc, &attr), each.status) << each.type << " " << each.result;
    }
}
