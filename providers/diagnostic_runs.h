// The classes of diagnostic tests: what the tests of each run on, and who starts them.
#pragma once

#include "providers/diagnostic_run.h"
#include "schema/ZEMLAR_EthLoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_EthernetPort.h"
#include "schema/ZEMLAR_FCPort.h"
#include "schema/ZEMLAR_LoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_MemoryDiagnosticTest.h"
#include "schema/ZEMLAR_PCILoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_PortController.h"

namespace zmlr
{

// clang-format off
inline constexpr Diagnostic_Run diagnostic_runs[] = {
    {&ZEMLAR_MemoryDiagnosticTest::static_meta_class,      {{&ZEMLAR_PortController::static_meta_class}, {}},
                                                           &DiagnosticHelper::runMemoryTest},
    {&ZEMLAR_LoopbackDiagnosticTest::static_meta_class,    {{&ZEMLAR_FCPort::static_meta_class}, {}},
                                                           &DiagnosticHelper::runLoopbackTest},
    {&ZEMLAR_PCILoopbackDiagnosticTest::static_meta_class, {{&ZEMLAR_FCPort::static_meta_class,       "PCI Loopback Test is requested for FC Port"},
                                                            {&ZEMLAR_EthernetPort::static_meta_class, "PCI Loopback Test is requested for Ethernet Port"}},
                                                           &DiagnosticHelper::runPCILoopbackTest},
    {&ZEMLAR_EthLoopbackDiagnosticTest::static_meta_class, {{&ZEMLAR_EthernetPort::static_meta_class}, {}},
                                                           &DiagnosticHelper::runEthLoopbackTest},
};
// clang-format on

} // namespace zmlr
