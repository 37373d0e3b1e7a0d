// Requests to the Fibre Channel side of one I/O controller.
#include "sim/commands/row.h"

namespace hxasim
{

namespace
{

constexpr hxa_iocfc_fwcfg_t firmware{.num_fabrics = 1,
                                     .num_lports = 256,
                                     .num_rports = 1024,
                                     .num_ioim_reqs = 2000,
                                     .num_tskim_reqs = 128,
                                     .num_iotm_reqs = 0,
                                     .num_tsktm_reqs = 0,
                                     .num_fcxp_reqs = 64,
                                     .num_uf_bufs = 64,
                                     .num_cqs = 4,
                                     .fw_tick_res = 64,
                                     .rsvd = {}};

constexpr hxa_iocfc_drvcfg_t driver{.num_reqq_elems = 1024,
                                    .num_rspq_elems = 512,
                                    .num_sgpgs = 2048,
                                    .num_sboot_tgts = 16,
                                    .num_sboot_luns = 16,
                                    .ioc_recover = 1,
                                    .min_cfg = 0,
                                    .path_tov = 30,
                                    .delay_comp = HXA_FALSE,
                                    .rsvd = 0};

void answer_iocfc_attributes(Call& call, hxa_ioctl_iocfc_attr_t& record)
{
    record.attr = {.fwcfg = firmware, .drvcfg = driver, .intr_attr = call.ioc->interrupts};
}

void answer_interrupts(Call& call, hxa_ioctl_iocfc_intr_t& record)
{
    record.status = record.attr.coalesce <= HXA_TRUE ? HXA_STATUS_OK : HXA_STATUS_EINVAL;
    if (record.status != HXA_STATUS_OK)
        return;
    call.ioc->interrupts = record.attr;
    ++call.ioc->stats.fw_stats.ic_reqs;
    ++call.ioc->fc_stats.ioc_stats.ic_reqs;
}

void answer_iocfc_statistics(Call& call, hxa_ioctl_iocfc_stats_t& record)
{
    ++call.ioc->fc_stats.ioc_stats.stats_reqs;
    record.stats = call.ioc->fc_stats;
}

void answer_iocfc_reset_statistics(Call& call, hxa_ioctl_gen_t&) { call.ioc->fc_stats = {}; }

constexpr auto interrupts = [](auto& record) { return std::tie(record.attr); };

// clang-format off
constexpr Row iocfc_table[] = {
    ioc_row<answer_iocfc_attributes>(      "IOCMD_IOCFC_GET_ATTR"),
    ioc_row<answer_iocfc_statistics>(      "IOCMD_IOCFC_GET_STATS"),
    ioc_row<answer_iocfc_reset_statistics>("IOCMD_IOCFC_RESET_STATS"),
    ioc_row<answer_interrupts>(            "IOCMD_IOCFC_SET_INTR",    interrupts),
};
// clang-format on

} // namespace

std::span<const Row> iocfc_rows() { return iocfc_table; }

} // namespace hxasim
