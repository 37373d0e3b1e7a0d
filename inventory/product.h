// ZEMLAR_Product: one adapter as a product.
#pragma once

#include "inventory/hba_info.h"
#include "runtime/instance.h"
#include "schema/ZEMLAR_Product.h"

namespace zmlr
{

Ref<ZEMLAR_Product> getProductInstance(const _hbaInfo& info);

} // namespace zmlr
