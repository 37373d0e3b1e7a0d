// ZEMLAR_AdapterSoftwareIdentity: the software of one adapter: its drivers, its firmware, its boot code.
#pragma once

#include "inventory/hba_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_AdapterSoftwareIdentity.h"

namespace zmlr
{

// CIM_SoftwareIdentity.Classifications
enum softwareType_t : uint16
{
    SOFTWARE_DRIVER = 2,
    SOFTWARE_FIRMWARE = 10,
    SOFTWARE_BIOS = 11
};

// `is_ethernet` tells of a driver which side it drives. A driver is named by its module, everything else by the adapter.
Ref<ZEMLAR_AdapterSoftwareIdentity> getAdapterSoftwareIdentityInstance(const _hbaInfo& info, softwareType_t type,
                                                                       bool is_ethernet);

} // namespace zmlr
