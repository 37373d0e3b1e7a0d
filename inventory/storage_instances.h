// The instances that describe one logical unit behind an FC port: a disk or a tape device.
#pragma once

#include "inventory/hba_port_info.h"
#include "inventory/scsi_pages.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_StorageExtent.h"
#include "schema/ZEMLAR_TapeDrive.h"

namespace zmlr
{

// `port` is the initiator port through which the unit was found.
Ref<ZEMLAR_StorageExtent> getStorageExtentInstance(const _hbaPortInfo& port, const _hbaLunInfo& lun);
Ref<ZEMLAR_TapeDrive> getTapeDriveInstance(const _hbaPortInfo& port, const _hbaLunInfo& lun);

} // namespace zmlr
