// How runs are started: the checks of each kind of test, and the start that they share.
#include "diagnostics/diagnostic_helper.h"
#include "diagnostics/exit_hook.h"
#include "diagnostics/module_stay.h"
#include "diagnostics/test_procedures.h"
#include "hxal/hxal.h"
#include "inventory/adapter_lookup.h"
#include "inventory/address_text.h"
#include "runtime/log.h"
#include "runtime/thread.h"
#include "runtime/trace.h"
#include "schema/ZEMLAR_ConcreteJob.h"

#include <exception>
#include <memory>
#include <optional>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

using Refusal = std::optional<Run_Code>;

Started refused(Run_Code code) { return {Ref<Instance>(), code}; }

bool is_mac(const String& address) { return address.size() == ProviderUtil::mac_text_size - 1; }
bool is_wwn(const String& address) { return address.size() == ProviderUtil::wwn_text_size - 1; }

Refusal find_handle(DiagnosticTestInput& input)
{
    input.handle = ProviderUtil::getHxalHandlerByPortAddress(input.element.address, is_wwn(input.element.address));
    if (input.handle)
        return {};
    ZMLR_LOG(LL_ERR, "hxal handler is NULL.");
    return RUN_FAILED;
}

// The port with an address of either kind becomes the element under test.
Refusal take_port(const String& address, DiagnosticTestInput& input)
{
    if (!is_mac(address) && !is_wwn(address))
    {
        ZMLR_LOG(LL_ERR, "Invalid port WWN or MAC value");
        return RUN_INVALID_PARAMETER;
    }
    ZMLR_LOG(LL_INFO, "Given Port %s : %s", is_mac(address) ? "MAC" : "WWN", address.c_str());
    input.element = {is_mac(address) ? CLASSID_EthernetPort : CLASSID_FCPort, address};
    return find_handle(input);
}

Refusal take_ethernet_port(const String& address, DiagnosticTestInput& input)
{
    if (!is_mac(address))
    {
        ZMLR_LOG(LL_ERR, "Invalid port MAC value");
        return RUN_INVALID_PARAMETER;
    }
    return take_port(address, input);
}

uint32 choose_speed(hxa_ioc_type_e type)
{
    switch (type)
    {
    case HXA_IOC_TYPE_FCoE:
    case HXA_IOC_TYPE_LL:
        ZMLR_LOG(LL_INFO, "Speed chosen : 10 GBS");
        return 10;
    case HXA_IOC_TYPE_FC:
        ZMLR_LOG(LL_INFO, "Speed chosen : 4 GBS");
        return 4;
    default:
        return 0;
    }
}

DiagnosticJob createDiagnosticJob(const DiagnosticTestInput& input)
{
    const Scope_Trace trace(log_source);
    DiagnosticJob job;
    job.name = ProviderUtil::getDiagTestName(input.test->id);
    job.element = input.element;
    job.startTime = Datetime::now();
    return job;
}

// What a run's thread is given: it owns it.
struct Assignment
{
    const Procedure& procedure;
    Test_Run run;
};

void* run_test(void* argument)
{
    const std::unique_ptr<Assignment> assignment(static_cast<Assignment*>(argument));
    carry_out(assignment->procedure, assignment->run);
    return nullptr;
}

// The thread is let go at once: nobody joins it.
bool make_thread(std::unique_ptr<Assignment> assignment)
try
{
    Thread thread;
    if (Thread::create_joinable(thread, run_test, assignment.get()) != 0)
        return false;
    static_cast<void>(assignment.release());
    return true;
}
catch (const std::exception&)
{
    return false;
}

} // namespace

Started DiagnosticHelper::start(DiagnosticTestInput input, const Procedure& procedure)
{
    ZMLR_LOG(LL_INFO, "Creating the Job instance.");
    DiagnosticJob job = createDiagnosticJob(input);
    input.jobLabel = job.name;
    Ref<ZEMLAR_ConcreteJob> name(ZEMLAR_ConcreteJob::create());
    name->InstanceID.set(job.name);

    std::unique_ptr<Assignment> assignment(new Assignment{procedure, Test_Run(std::move(input), *this)});
    const auto begin = [&]
    {
        if (!stay_in_memory())
            return false;
        hook_exit(_jobs);
        return make_thread(std::move(assignment));
    };
    if (!_jobs.start(std::move(job), begin))
        return refused(RUN_FAILED);
    return {Ref<Instance>(name.steal()), RUN_STARTED};
}

Started DiagnosticHelper::runMemoryTest(const String& address, const String&)
{
    const Scope_Trace trace(log_source);
    if (_jobs.isAnyJobRunning())
        return refused(RUN_FAILED);
    ZMLR_LOG(LL_INFO, "Adapter Address : %s", address.c_str());
    DiagnosticTestInput input;
    input.test = &diagnostic_tests()[DIAG_TEST_MEMORY];
    input.element = {CLASSID_PortController, address};
    input.adapterId = ProviderUtil::getAdapterId(address);
    if (input.adapterId == 0)
        return refused(RUN_INVALID_PARAMETER);
    ZMLR_LOG(LL_INFO, "Adapter ID  : %d", input.adapterId);
    input.handle = ProviderUtil::getHxalHandlerByAdapterId(input.adapterId);
    if (!input.handle)
        return refused(RUN_FAILED);
    return start(std::move(input), memory_procedure);
}

Started DiagnosticHelper::runLoopbackTest(const String& address, const String& test_name)
{
    const Scope_Trace trace(log_source);
    if (_jobs.isAnyJobRunning())
        return refused(RUN_FAILED);
    DiagnosticTestInput input;
    if (const Refusal refusal = take_port(address, input))
        return refused(*refusal);
    const hxa_ioc_type_e type = hxal_ioc_get_ioc_type(input.handle);
    input.speed = choose_speed(type);
    input.test = find_diagnostic_test(CLASSID_LoopbackDiagnosticTest, test_name);
    if (type == HXA_IOC_TYPE_FCoE && input.test && input.test->id == DIAG_TEST_INTERNAL_LOOPBACK)
        return refused(RUN_NOT_SUPPORTED);
    if (!input.test)
        return refused(RUN_INVALID_PARAMETER);
    ZMLR_LOG(LL_INFO, "Loopback test mode : %s", input.test->mode_name);
    return start(std::move(input), loopback_procedure);
}

Started DiagnosticHelper::runPCILoopbackTest(const String& address, const String&)
{
    const Scope_Trace trace(log_source);
    if (_jobs.isAnyJobRunning())
        return refused(RUN_FAILED);
    DiagnosticTestInput input;
    input.test = &diagnostic_tests()[DIAG_TEST_PCI_LOOPBACK];
    if (const Refusal refusal = take_port(address, input))
        return refused(*refusal);
    return start(std::move(input), pci_loopback_procedure);
}

Started DiagnosticHelper::runEthLoopbackTest(const String& address, const String& test_name)
{
    const Scope_Trace trace(log_source);
    if (_jobs.isAnyJobRunning())
        return refused(RUN_FAILED);
    DiagnosticTestInput input;
    if (const Refusal refusal = take_ethernet_port(address, input))
        return refused(*refusal);
    input.test = find_diagnostic_test(CLASSID_EthLoopbackDiagnosticTest, test_name);
    if (!input.test)
        return refused(RUN_INVALID_PARAMETER);
    ZMLR_LOG(LL_INFO, "Eth Loopback test mode : %s", input.test->mode_name);
    return start(std::move(input), eth_loopback_procedure);
}

} // namespace zmlr
