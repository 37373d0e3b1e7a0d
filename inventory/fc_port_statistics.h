// ZEMLAR_FCPortStatistics: what one FC port counts.
#pragma once

#include "inventory/hba_port_info.h"
#include "inventory/port_statistics.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_FCPortStatistics.h"

namespace zmlr
{

// `is_fcoe` tells which counters the record holds.
Ref<ZEMLAR_FCPortStatistics> getFCPortStatisticsInstance(const _hbaPortInfo& info, const prov_pport_stats_u& statistics,
                                                         bool is_fcoe);

} // namespace zmlr
