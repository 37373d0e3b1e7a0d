#include "providers/matches_diagnostics.h"

#include "diagnostics/test_catalogue.h"
#include "inventory/cim_values.h"
#include "inventory/fchba_manager.h"
#include "providers/joining.h"
#include "runtime/log.h"
#include "schema/ZEMLAR_DiagnosticTest.h"

namespace zmlr
{

namespace
{

constexpr uint32 adapters = 0;
constexpr uint32 tests = 1;
constexpr uint32 ports = 2;

bool is_cna(const ZEMLAR_PortController& adapter)
{
    return !adapter.ControllerType.null && adapter.ControllerType.value == CONTROLLER_TYPE_OTHER;
}

bool is_internal_loopback(const ZEMLAR_DiagnosticTest& test)
{
    return test.Name.value.equali(ProviderUtil::getDiagTestName(DIAG_TEST_INTERNAL_LOOPBACK));
}

// False when the match is to end.
bool pair_with_tests(Joining& joining, const ZEMLAR_PortController& adapter, Instance* port)
{
    const char* const log_source = joining.source();
    for (uint32 i = 0; i < joining[tests].size(); i++)
    {
        auto* test = joining.at<ZEMLAR_DiagnosticTest>(tests, i);
        if (test && is_cna(adapter) && is_internal_loopback(*test))
            ZMLR_LOG(LL_INFO, " The PortController is CNA");
        else if (!joining.pair(tests, test, ports, port))
            return false;
    }
    return true;
}

} // namespace

Instance_Array all_tests(const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getAllDiagnosticTestInstances(request);
}

Instance_Array tests_of_adapters(const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getDiagnosticServicesForAdapter(request);
}

Instance_Array tests_of_fc_ports(const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getDiagnosticServicesForFCPort(request);
}

Instance_Array tests_of_ethernet_ports(const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getDiagnosticServicesForEthernetPort(request);
}

void tests_on_ports_of_adapters(Joining& joining)
{
    if (!joining.ask(adapters) || !joining.ask(tests))
        return;
    for (uint32 i = 0; i < joining[adapters].size(); i++)
    {
        const auto* adapter = joining.at<ZEMLAR_PortController>(adapters, i);
        if (!adapter)
            continue;
        if (!joining.ask(ports, adapter))
            return;
        for (Instance* port : joining[ports])
        {
            if (!pair_with_tests(joining, *adapter, port))
                return;
        }
    }
}

} // namespace zmlr
