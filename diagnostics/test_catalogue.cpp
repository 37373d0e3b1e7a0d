#include "diagnostics/test_catalogue.h"

#include "hxal/records/diag.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <algorithm>
#include <iterator>

namespace zmlr
{

namespace
{

// CIM_DiagnosticTest.Characteristics
constexpr uint16 IS_EXCLUSIVE = 2;
constexpr uint16 IS_DESTRUCTIVE = 4;
constexpr uint16 ADDITIONAL_HARDWARE_REQUIRED = 10;

constexpr uint32 EXT = HXA_PPORT_OPMODE_LB_CBL; // through a plug in the module, or a cable
constexpr uint32 INT = HXA_PPORT_OPMODE_LB_INT;
constexpr uint32 SERDES = HXA_PPORT_OPMODE_LB_EXT; // behind the serialiser

// clang-format off
constexpr Diagnostic_Test tests[] = {
//   identifier                       name                       class                              destructive, hardware, loops, mode
    {DIAG_TEST_NONE,                  "--",                      CLASSID_None,                      false, false, 0,       0,      ""},
    {DIAG_TEST_MEMORY,                "MemoryTest",              CLASSID_MemoryDiagnosticTest,      true,  false, 0,       0,      ""},
    {DIAG_TEST_INTERNAL_LOOPBACK,     "InternalLoopbackTest",    CLASSID_LoopbackDiagnosticTest,    true,  false, 0x20000, INT,    "internal"},
    {DIAG_TEST_EXTERNAL_LOOPBACK,     "ExternalLoopbackTest",    CLASSID_LoopbackDiagnosticTest,    true,  true,  0x20000, EXT,    "external"},
    {DIAG_TEST_SERDES_LOOPBACK,       "SerdesLoopbackTest",      CLASSID_LoopbackDiagnosticTest,    true,  false, 0x20000, SERDES, "serdes"},
    {DIAG_TEST_PCI_LOOPBACK,          "PCILoopbackTest",         CLASSID_PCILoopbackDiagnosticTest, false, false, 0x20000, 0,      ""},
    {DIAG_TEST_EXTERNAL_ETH_LOOPBACK, "ExternalEthLoopbackTest", CLASSID_EthLoopbackDiagnosticTest, true,  true,  0x10000, EXT,    "external"},
    {DIAG_TEST_SERDES_ETH_LOOPBACK,   "SerdesEthLoopbackTest",   CLASSID_EthLoopbackDiagnosticTest, true,  false, 0x10000, SERDES, "serdes"},
};
// clang-format on

String full_name(const Diagnostic_Test& test) { return String("Zemlar:") + test.name; }

} // namespace

std::span<const Diagnostic_Test> diagnostic_tests() { return tests; }

const Diagnostic_Test* find_diagnostic_test(classId_t class_id, const String& name)
{
    const auto fits = [&](const Diagnostic_Test& test) { return test.class_id == class_id && full_name(test).equali(name); };
    const auto* const test = std::ranges::find_if(tests, fits);
    return test == std::end(tests) ? nullptr : test;
}

Array<uint16> getDiagCharacteristics(diag_test_id_t id)
{
    constexpr const char* log_source = "DiagnosticHelper";
    const Scope_Trace trace(log_source);
    Array<uint16> characteristics = {IS_EXCLUSIVE};
    if (id == DIAG_TEST_NONE || id >= std::size(tests))
    {
        ZMLR_LOG(LL_WARN, "WARNING! Control should never come here");
        return characteristics;
    }
    if (tests[id].is_destructive)
        characteristics.append(IS_DESTRUCTIVE);
    if (tests[id].needs_hardware)
        characteristics.append(ADDITIONAL_HARDWARE_REQUIRED);
    return characteristics;
}

String ProviderUtil::getDiagTestName(diag_test_id_t id)
{
    constexpr const char* log_source = "ProviderUtil";
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "Diag Test Id = %d", static_cast<int>(id));
    if (id >= std::size(tests))
    {
        ZMLR_LOG(LL_INFO, "Diag Test Id is greater than DIAG_NAME_INVALID");
        return "INVALID DIAGNOSTIC ID";
    }
    ZMLR_LOG(LL_INFO, "Diagnostic Name = %s", tests[id].name);
    return full_name(tests[id]);
}

} // namespace zmlr
