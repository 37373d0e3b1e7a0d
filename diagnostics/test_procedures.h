// What each kind of test does.
#pragma once

#include "diagnostics/procedure.h"

namespace zmlr
{

extern const Procedure memory_procedure;
extern const Procedure loopback_procedure; // of an FC port
extern const Procedure eth_loopback_procedure;
extern const Procedure pci_loopback_procedure;

} // namespace zmlr
