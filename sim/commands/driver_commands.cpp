// Requests to a driver as a whole.
#include "sim/commands/row.h"

#include <algorithm>

namespace hxasim
{

namespace
{

void answer_version(Call& call, hxa_ioctl_ioc_get_version_t& record)
{
    const auto& driver = call.host.driver(call.descriptor.node);
    record.status = static_cast<hxa_status_t>(driver.version_status);
    record.version = driver.version;
}

void answer_instances(Call& call, hxa_ioctl_ioc_get_inst_t& record)
{
    std::uint32_t count = 0;
    for (const auto& ioc : call.host.iocs(call.descriptor.node))
    {
        if (!ioc.adapter->plugged)
            continue;
        auto& byte = record.bm[ioc.instance / 8];
        byte = static_cast<std::uint8_t>(byte | 1U << ioc.instance % 8);
        count = std::max(count, ioc.instance + 1);
    }
    record.cnt = call.host.driver(call.descriptor.node).instance_count.value_or(count);
}

// clang-format off
constexpr Row driver_table[] = {
    driver_row<answer_version>(  "IOCMD_IOC_GET_VERSION"),
    driver_row<answer_instances>("IOCMD_IOC_GET_INST"),
};
// clang-format on

} // namespace

std::span<const Row> driver_rows() { return driver_table; }

} // namespace hxasim
