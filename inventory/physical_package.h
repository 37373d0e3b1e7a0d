// ZEMLAR_PhysicalPackage: the card of one adapter.
#pragma once

#include "inventory/hba_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_PhysicalPackage.h"

namespace zmlr
{

// Its tag holds the adapter's address; ProviderUtil::getNodeMACOrWWNFromTag() takes it out again.
Ref<ZEMLAR_PhysicalPackage> getPhysicalPackageInstance(const _hbaInfo& info);

} // namespace zmlr
