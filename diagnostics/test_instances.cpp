#include "diagnostics/test_instances.h"

#include "diagnostics/test_catalogue.h"
#include "inventory/adapter_lookup.h"
#include "inventory/property_text.h"
#include "inventory/provider_util.h"
#include "runtime/trace.h"
#include "schema/ZEMLAR_DiagnosticSoftwareIdentity.h"
#include "schema/ZEMLAR_DiagnosticTest.h"
#include "schema/ZEMLAR_EthLoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_LoopbackDiagnosticTest.h"
#include "schema/ZEMLAR_MemoryDiagnosticTest.h"
#include "schema/ZEMLAR_PCILoopbackDiagnosticTest.h"

#include <algorithm>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

struct Test_Class
{
    classId_t id;
    const Meta_Class* meta_class;
    const char* element_name;
};

// clang-format off
constexpr Test_Class test_classes[] = {
    {CLASSID_MemoryDiagnosticTest,      &ZEMLAR_MemoryDiagnosticTest::static_meta_class,      "Memory Diagnostic Test"},
    {CLASSID_LoopbackDiagnosticTest,    &ZEMLAR_LoopbackDiagnosticTest::static_meta_class,    "Loopback Diagnostic Test"},
    {CLASSID_PCILoopbackDiagnosticTest, &ZEMLAR_PCILoopbackDiagnosticTest::static_meta_class, "PCI Loopback Diagnostic Test"},
    {CLASSID_EthLoopbackDiagnosticTest, &ZEMLAR_EthLoopbackDiagnosticTest::static_meta_class, "Eth Loopback Diagnostic Test"},
};
// clang-format on

// The order in which all tests are told.
constexpr diag_test_id_t services[] = {
    DIAG_TEST_MEMORY,       DIAG_TEST_INTERNAL_LOOPBACK,   DIAG_TEST_SERDES_LOOPBACK,       DIAG_TEST_EXTERNAL_LOOPBACK,
    DIAG_TEST_PCI_LOOPBACK, DIAG_TEST_SERDES_ETH_LOOPBACK, DIAG_TEST_EXTERNAL_ETH_LOOPBACK,
};

Ref<Instance> test_instance(const Diagnostic_Test& row, const Inventory_Request& request)
{
    const Test_Class& test_class = *std::ranges::find(test_classes, row.class_id, &Test_Class::id);
    Ref<Instance> instance(create(test_class.meta_class, true));
    auto* test = cast<ZEMLAR_DiagnosticTest>(instance.ptr());
    test->Name.set(ProviderUtil::getDiagTestName(row.id));
    test->ElementName.set(test_class.element_name);
    test->SystemName.set(property_text(request.host.text()));
    test->CreationClassName.set(ProviderUtil::getClassName(row.class_id));
    test->SystemCreationClassName.set(ProviderUtil::getClassName(CLASSID_ComputerSystem));
    test->Characteristics.set(getDiagCharacteristics(row.id));
    test->OtherCharacteristicDescription.set("");
    return instance;
}

} // namespace

Instance_Array getDiagnosticTestInstances(classId_t class_id, const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    for (const Diagnostic_Test& test : diagnostic_tests())
    {
        if (test.class_id == class_id)
            instances.adopt(test_instance(test, request));
    }
    return instances;
}

Instance_Array getDiagnosticServices(const Inventory_Request& request)
{
    const Scope_Trace trace(log_source);
    Instance_Array instances;
    for (const diag_test_id_t id : services)
        instances.adopt(test_instance(diagnostic_tests()[id], request));
    return instances;
}

Ref<Instance> getDiagnosticSoftwareIdentityInstance()
{
    const Scope_Trace trace(log_source);
    const String name = "Diagnostic Software";
    constexpr uint16 DIAGNOSTIC_SOFTWARE = 7; // CIM_SoftwareIdentity.Classifications

    Ref<ZEMLAR_DiagnosticSoftwareIdentity> software(ZEMLAR_DiagnosticSoftwareIdentity::create());
    software->InstanceID.set("Zemlar:Diagnostic");
    software->Caption.set(name);
    software->Description.set(name);
    software->ElementName.set(name);
    software->Name.set(name);
    software->VersionString.set(ProviderUtil::getDriverVersion());
    software->Classifications.set({DIAGNOSTIC_SOFTWARE});
    software->Manufacturer.set("Zemlar");
    software->MajorVersion.set(2);
    software->MinorVersion.set(2);
    software->RevisionNumber.set(0);
    software->BuildNumber.set(0);
    return Ref<Instance>(software.steal());
}

} // namespace zmlr
