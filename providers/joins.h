// All tables of joins, one of each subsystem.
#pragma once

#include "providers/joins_diagnostics.h"
#include "providers/joins_inventory.h"
#include "providers/joins_profiles.h"

namespace zmlr
{

// The row of an association class; without one the call does not compile.
constexpr const Join& join_of(const Meta_Class& meta_class)
{
    return row_of(meta_class, inventory_joins, profile_joins, diagnostic_joins);
}

} // namespace zmlr
