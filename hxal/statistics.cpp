#include "hxal/statistics.h"

#include "hxal/internal/fixed_text.h"
#include "hxal/internal/lport_request.h"

#include <bit>

namespace
{

// In the order of the counters in their records.
// clang-format off
constexpr const char* fc_port_names[] = {
    "Seconds since stats is reset",
    "Tx frames",
    "Tx words",
    "TX LIP",
    "Tx NOS",
    "Tx OLS",
    "Tx LR",
    "Tx LRR",
    "Rx frames",
    "Rx words",
    "Rx LIP",
    "Rx NOS",
    "Rx OLS",
    "Rx LR",
    "Rx LRR",
    "Rx CRC err frames",
    "Rx CRC err good EOF frames",
    "Rx undersized frames",
    "Rx oversized frames",
    "Rx frames with bad EOF",
    "Errored frames",
    "Dropped frames",
    "Link Failure (LF) count",
    "Loss of sync count",
    "Loss of signal count",
    "Primitive sequence protocol err.",
    "Invalid ordered sets",
    "Encoding err nonframe_8b10b",
    "Encoding err frame_8b10b",
};
static_assert(std::size(fc_port_names) == HXAL_FC_PORT_STATS);

constexpr const char* eth_port_names[] = {
    "Seconds since stats is reset",
    "Frames 64 bytes",
    "Frames 65-127 bytes",
    "Frames 128-255 bytes",
    "Frames 256-511 bytes",
    "Frames 512-1023 bytes",
    "Frames 1024-1518 bytes",
    "Frames 1519-1522 bytes",
    "Tx bytes",
    "Tx packets",
    "Tx multicast packets",
    "Tx broadcast packets",
    "Tx control frame",
    "Tx drops",
    "Tx jabber",
    "Tx FCS error",
    "Tx fragments",
    "Rx bytes",
    "Rx packets",
    "Rx multicast packets",
    "Rx broadcast packets",
    "Rx control frames",
    "Rx unknown opcode",
    "Rx drops",
    "Rx jabber",
    "Rx FCS errors",
    "Rx alignment errors",
    "Rx frame len errors",
    "Rx code errors",
    "Rx fragments",
    "Rx pause",
    "Rx zero pause",
    "Tx pause",
    "Tx zero pause",
    "Rx fcoe pause",
    "Rx FCoE zero pause",
    "Tx FCoE pause",
    "Tx FCoE zero pause",
};
static_assert(std::size(eth_port_names) == HXAL_ETH_PORT_STATS);

constexpr const char* fcoe_names[] = {
    "Seconds since stats reset",
    "CEE link up",
    "CEE link down",
    "FIP link up",
    "FIP link down",
    "FIP failures",
    "Invalid mac assignments",
    "Vlan requests",
    "Vlan notifications",
    "Vlan notification errors",
    "Vlan request timeouts",
    "Vlan invalids",
    "Discovery requests",
    "Discovery responses",
    "Discovery error frames",
    "Discovery unsolicited",
    "Discovery timeouts",
    "Discovery FCF not avail",
    "FIP link service req unsupp.",
    "FIP link service req errors",
    "FIP logo",
    "Clear virtual link requests",
    "FIP operation unsupp.",
    "FIP untagged frames",
    "Tx FCoE unicast frames",
    "Tx FCoE unicast vlan frames",
    "Tx FCoE unicast octets",
    "Tx FCoE multicast frames",
    "Tx FCoE multicast vlan frames",
    "Tx FCoE multicast octets",
    "Tx FCoE broadcast frames",
    "Tx FCoE broadcast vlan frames",
    "Tx FCoE broadcast octets",
    "Tx timeouts",
    "Transmit parity err",
    "Transmit FID parity err",
    "Rx unicast octets",
    "Rx unicast frames",
    "Rx unicast vlan frames",
    "Rx multicast octets",
    "Rx multicast frames",
    "Rx multicast vlan frames",
    "Rx broadcast octets",
    "Rx broadcast frames",
    "Rx broadcast vlan frames",
};
static_assert(std::size(fcoe_names) == HXAL_FCOE_STATS);

constexpr const char* lport_names[] = {
    "ns_plogi_sent",
    "ns_plogi_rsp_err",
    "ns_plogi_acc_err",
    "ns_plogi_accepts",
    "NS command rejects",
    "ns_plogi_unknown_rsp",
    "ns_plogi_alloc_wait",
    "NS command retries",
    "NS command timeouts",
    "ns_rspnid_sent",
    "ns_rspnid_accepts",
    "ns_rspnid_rsp_err",
    "ns_rspnid_rejects",
    "ns_rspnid_alloc_wait",
    "ns_rftid_sent",
    "ns_rftid_accepts",
    "ns_rftid_rsp_err",
    "ns_rftid_rejects",
    "ns_rftid_alloc_wait",
    "ns_rffid_sent",
    "ns_rffid_accepts",
    "ns_rffid_rsp_err",
    "ns_rffid_rejects",
    "ns_rffid_alloc_wait",
    "ns_gidft_sent",
    "ns_gidft_accepts",
    "ns_gidft_rsp_err",
    "ns_gidft_rejects",
    "ns_gidft_unknown_rsp",
    "ns_gidft_alloc_wait",
    "MS command retries",
    "MS command timeouts",
    "ms_plogi_sent",
    "ms_plogi_rsp_err",
    "ms_plogi_acc_err",
    "ms_plogi_accepts",
    "NS command rejects",
    "ms_plogi_unknown_rsp",
    "ms_plogi_alloc_wait",
    "Num of RSCN received",
    "Num portid format RSCN",
    "unsolicited recv frames",
    "dropped received frames",
};
static_assert(std::size(lport_names) == HXAL_LPORT_STATS);
// clang-format on

// Any block of counters as the row of numbers that it is.
template <typename Number, typename Block> auto row_of(const Block& block)
{
    return std::bit_cast<std::array<Number, sizeof(Block) / sizeof(Number)>>(block);
}

template <typename Pair, typename Number> void pair(const Number* values, Pair* out, const char* const* names, int count)
{
    for (int i = 0; i < count; ++i)
    {
        hxal::keep_text(out[i].name, names[i]);
        out[i].value = values[i];
    }
}

} // namespace

void hxal_stats_to_nv_pair(const uint32_t* values, hxal_stats_t* out, const char* const* names, int count)
{
    pair(values, out, names, count);
}

void hxal_stats_long_to_nv_pair(const uint64_t* values, hxal_stats_long_t* out, const char* const* names, int count)
{
    pair(values, out, names, count);
}

hxa_status_t hxal_port_get_stats(const hxal_t* ioc, hxal_stats_long_t* stats)
{
    if (!ioc || !stats)
        return HXA_STATUS_EINVAL;
    hxa_pport_stats_t counters{};
    auto record = hxal::request_for<hxa_ioctl_port_stats_t>(*ioc);
    record.buf_size = sizeof counters;
    record.buf_ptr = hxal::sender_address(&counters);
    if (const hxa_status_t status = hxal::exchange(*ioc, "IOCMD_PORT_GET_STATS", record); status != HXA_STATUS_OK)
        return status;
    const auto values = row_of<uint64_t>(counters);
    if (ioc->ioc_type == HXA_IOC_TYPE_FC)
        hxal_stats_long_to_nv_pair(values.data(), stats, fc_port_names, HXAL_FC_PORT_STATS);
    else
        hxal_stats_long_to_nv_pair(values.data(), stats, eth_port_names, HXAL_ETH_PORT_STATS);
    return HXA_STATUS_OK;
}

hxa_status_t hxal_fcoe_get_stats(const hxal_t* ioc, hxal_stats_long_t* stats)
{
    if (!ioc || !stats)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_fcport_stats_t>(*ioc);
    if (const hxa_status_t status = hxal::exchange(*ioc, "IOCMD_FCOE_GET_STATS", record); status != HXA_STATUS_OK)
        return status;
    hxal_stats_long_to_nv_pair(row_of<uint64_t>(record.stats).data(), stats, fcoe_names, HXAL_FCOE_STATS);
    return HXA_STATUS_OK;
}

hxa_status_t hxal_lport_get_stats(const hxal_t* ioc, uint16_t vf_id, wwn_t pwwn, hxal_stats_t* stats)
{
    if (!ioc || !stats)
        return HXA_STATUS_EINVAL;
    auto record = hxal::lport_request_for<hxa_ioctl_lport_stats_t>(*ioc, vf_id, pwwn);
    if (const hxa_status_t status = hxal::exchange(*ioc, "IOCMD_LPORT_GET_STATS", record); status != HXA_STATUS_OK)
        return status;
    hxal_stats_to_nv_pair(row_of<uint32_t>(record.stats).data(), stats, lport_names, HXAL_LPORT_STATS);
    return HXA_STATUS_OK;
}
