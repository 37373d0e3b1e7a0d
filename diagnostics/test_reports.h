// How tests went: what is logged and recorded of what they answered.
#pragma once

#include "diagnostics/procedure.h"

namespace zmlr
{

void report_memory(Test_Run& run, const Outcome& outcome);
void report_loopback(Test_Run& run, const Outcome& outcome);
void report_eth_loopback(Test_Run& run, const Outcome& outcome);
void report_pci_loopback(Test_Run& run, const Outcome& outcome);

} // namespace zmlr
