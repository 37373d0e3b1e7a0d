// The tests that the module offers: one table of all of them.
#pragma once

#include "inventory/class_id.h"
#include "runtime/array.h"
#include "runtime/string.h"

#include <span>

namespace zmlr
{

enum diag_test_id_t : uint32
{
    DIAG_TEST_NONE = 0,
    DIAG_TEST_MEMORY = 1,
    DIAG_TEST_INTERNAL_LOOPBACK = 2,
    DIAG_TEST_EXTERNAL_LOOPBACK = 3,
    DIAG_TEST_SERDES_LOOPBACK = 4,
    DIAG_TEST_PCI_LOOPBACK = 5,
    DIAG_TEST_EXTERNAL_ETH_LOOPBACK = 6,
    DIAG_TEST_SERDES_ETH_LOOPBACK = 7,
};

struct Diagnostic_Test
{
    diag_test_id_t id;
    const char* name;    // behind "Zemlar:"
    classId_t class_id;  // of the test's instance
    bool is_destructive; // takes its element out of service
    bool needs_hardware; // a loopback plug
    uint32 loops;        // how often frames are sent
    uint32 mode;         // of a loopback, hxa_pport_opmode_t
    const char* mode_name;
};

// All tests by their identifiers, DIAG_TEST_NONE included.
std::span<const Diagnostic_Test> diagnostic_tests();

// The test of that class with that full name, in any case of letters; null when there is none.
const Diagnostic_Test* find_diagnostic_test(classId_t class_id, const String& full_name);

// CIM_DiagnosticTest.Characteristics.
Array<uint16> getDiagCharacteristics(diag_test_id_t id);

namespace ProviderUtil
{

// The test's full name, by which everything knows it: "Zemlar:" and its name. "INVALID DIAGNOSTIC ID" for what is no identifier.
String getDiagTestName(diag_test_id_t id);

} // namespace ProviderUtil

} // namespace zmlr
