// Requests to the transceiver of the port behind an I/O controller.
#include "sim/commands/row.h"

namespace hxasim
{

namespace
{

// Why the firmware cannot read the module; HXA_STATUS_OK when it can.
hxa_status_t refusal(const Ioc& ioc)
{
    if (*ioc.state != HXA_IOC_OPERATIONAL)
        return HXA_STATUS_IOC_NON_OP;
    return ioc.port->sfp.present ? HXA_STATUS_OK : HXA_STATUS_NO_SFP_DEV;
}

void answer_memory(Call& call, hxa_ioctl_sfp_show_t& record)
{
    record.status = refusal(*call.ioc);
    if (record.status == HXA_STATUS_OK)
        record.sfp = call.ioc->port->sfp.memory;
}

void answer_media(Call& call, hxa_ioctl_sfp_media_t& record)
{
    record.status = refusal(*call.ioc);
    if (record.status == HXA_STATUS_OK)
        record.media = call.ioc->port->sfp.media;
}

void answer_sfp_speed(Call& call, hxa_ioctl_sfp_speed_t& record)
{
    const auto& module = call.ioc->port->sfp;
    record.status = refusal(*call.ioc);
    if (record.status == HXA_STATUS_OK && module.media == HXA_SFP_MEDIA_UNSUPPORT)
        record.status = HXA_STATUS_SFP_UNSUPP;
    else if (record.status == HXA_STATUS_OK && !supports(module, record.speed))
        record.status = HXA_STATUS_UNSUPP_SPEED;
}

constexpr auto sfp_speed = [](auto& record) { return std::tie(record.speed); };

// clang-format off
constexpr Row sfp_table[] = {
    ioc_row<answer_memory>(   "IOCMD_DIAG_SFP"),
    ioc_row<answer_media>(    "IOCMD_SFP_MEDIA"),
    ioc_row<answer_sfp_speed>("IOCMD_SFP_SPEED", sfp_speed),
};
// clang-format on

} // namespace

std::span<const Row> sfp_rows() { return sfp_table; }

} // namespace hxasim
