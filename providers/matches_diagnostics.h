// What the rows of joins_diagnostics.h need that is special to them: which tests are asked for, and a match.
#pragma once

#include "inventory/inventory_request.h"
#include "providers/join.h"

namespace zmlr
{

// ---- sides ----

Instance_Array all_tests(const Inventory_Request& request);
Instance_Array tests_of_adapters(const Inventory_Request& request);
Instance_Array tests_of_fc_ports(const Inventory_Request& request);
Instance_Array tests_of_ethernet_ports(const Inventory_Request& request);

// ---- matches; the sides are those of their row ----

// Each FC port of each adapter with each test, but for the internal loopback test on the ports of a CNA. An adapter without FC
// ports ends it.
void tests_on_ports_of_adapters(Joining& joining);

} // namespace zmlr
