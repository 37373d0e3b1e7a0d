#include "diagnostics/test_procedures.h"

#include "diagnostics/test_reports.h"
#include "inventory/port_disabled.h"
#include "runtime/time.h"

namespace zmlr
{

namespace
{

using Input = DiagnosticTestInput;

bool is_adapter_out(const Input& input) { return hxal_adapter_is_disabled(input.adapterId) != HXA_FALSE; }
hxa_status_t take_adapter_out(const Input& input) { return hxal_adapter_disable(input.adapterId); }
void put_adapter_back(const Input& input) { hxal_adapter_enable(input.adapterId); }

bool is_port_out(const Input& input) { return isPortDisabled(input.element.address); }
hxa_status_t take_port_out(const Input& input) { return hxal_port_disable(input.handle); }
void put_port_back(const Input& input) { hxal_port_enable(input.handle); }

// Of a port with two functions one may have gone out before the other one refused.
void put_half_back(const Input& input)
{
    if (hxal_ioc_get_ioc_type(input.handle) != HXA_IOC_TYPE_FC)
        hxal_port_enable(input.handle);
}

void test_memory(const Input& input, Outcome& outcome) { outcome.rc = hxal_diag_memtest(input.handle, 0, &outcome.memory); }

void test_loopback(const Input& input, Outcome& outcome)
{
    outcome.rc =
        hxal_diag_loopback(input.handle, input.test->mode, input.speed, input.test->loops, input.pattern, &outcome.loopback);
}

void test_eth_loopback(const Input& input, Outcome& outcome)
{
    outcome.rc = hxal_diag_eth_loopback(input.handle, input.test->mode, input.test->loops, input.pattern, &outcome.loopback);
}

void test_pci_loopback(const Input& input, Outcome& outcome)
{
    outcome.rc = hxal_diag_fwping(input.handle, input.test->loops, input.pattern, nullptr);
}

constexpr Service adapter_service = {
    .is_out = is_adapter_out,
    .take_out = take_adapter_out,
    .put_back = put_adapter_back,
    .undo = nullptr,
    .checking = {REC_ADAPTER_CHECKING},
    .was_out = {REC_ADAPTER_ALREADY_DISABLED},
    .was_in = {REC_ADAPTER_NOT_DISABLED},
    .taking_out = {REC_ADAPTER_DISABLING, LL_WARN},
    .putting_back = {REC_ADAPTER_ENABLING, LL_WARN},
};

constexpr Service port_service(diag_record_msg_t checking)
{
    return {
        .is_out = is_port_out,
        .take_out = take_port_out,
        .put_back = put_port_back,
        .undo = put_half_back,
        .checking = {checking},
        .was_out = {REC_PORT_ALREADY_DISABLED},
        .was_in = {REC_PORT_NOT_DISABLED},
        .taking_out = {REC_PORT_DISABLING},
        .putting_back = {REC_PORT_ENABLING},
    };
}

constexpr Service fc_port_service = port_service(REC_LOOPBACK_CHECKING);
constexpr Service ethernet_port_service = port_service(REC_ETH_CHECKING);

} // namespace

constinit const Procedure memory_procedure = {
    .name = "runMemoryTestThread",
    .service = &adapter_service,
    .pause = 0,
    .running = {{{REC_MEMORY_RUNNING}, {REC_MEMORY_TAKES_TIME}}},
    .test = test_memory,
    .evaluating = {REC_MEMORY_EVALUATING},
    .report = report_memory,
};

constinit const Procedure loopback_procedure = {
    .name = "runLoopbackTestThread",
    .service = &fc_port_service,
    .pause = 2 * Time::SEC,
    .running = {{{REC_LOOPBACK_RUNNING}}},
    .test = test_loopback,
    .evaluating = {REC_LOOPBACK_EVALUATING},
    .report = report_loopback,
};

constinit const Procedure eth_loopback_procedure = {
    .name = "runEthLoopbackTestThread",
    .service = &ethernet_port_service,
    .pause = 0,
    .running = {{{REC_ETH_RUNNING}}},
    .test = test_eth_loopback,
    .evaluating = {REC_ETH_EVALUATING},
    .report = report_eth_loopback,
};

constinit const Procedure pci_loopback_procedure = {
    .name = "runPCILoopbackTestThread",
    .service = nullptr,
    .pause = 0,
    .running = {{{REC_PCI_RUNNING}}},
    .test = test_pci_loopback,
    .evaluating = {REC_PCI_EVALUATING},
    .report = report_pci_loopback,
};

} // namespace zmlr
