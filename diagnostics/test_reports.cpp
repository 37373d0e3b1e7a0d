#include "diagnostics/test_reports.h"

#include <algorithm>
#include <iterator>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

const char* text_of(uint32 status) { return hxal_status_to_string(static_cast<int>(status)); }

// ---- memory ----

constexpr struct
{
    uint8 algorithm;
    const char* name;
} algorithms[] = {{1, "walk01"}, {2, "marchy"}, {8, "movi"}, {16, "tlapnpsf1t"}};

const char* name_of_algorithm(uint8 algorithm)
{
    const auto* const row = std::ranges::find_if(algorithms, [=](const auto& each) { return each.algorithm == algorithm; });
    return row == std::end(algorithms) ? "unknown" : row->name;
}

void log_memory_failure(const hxa_diag_memtest_result_t& result)
{
    ZMLR_LOG(LL_INFO, "Status         :\t0x%x", result.status);
    ZMLR_LOG(LL_INFO, "Addr           :\t0x%x", result.addr);
    ZMLR_LOG(LL_INFO, "Expected value :\t0x%x", result.exp);
    ZMLR_LOG(LL_INFO, "Actual value   :\t0x%x", result.act);
    ZMLR_LOG(LL_INFO, "Error state    :\t0x%x", result.err_status);
    ZMLR_LOG(LL_INFO, "Error address  :\t0x%x", result.err_addr);
    ZMLR_LOG(LL_INFO, "Algorithm      :\t%s", name_of_algorithm(result.algo));
    ZMLR_LOG(LL_INFO, "Memory test run status : %s", text_of(result.status));
}

// ---- loopback ----

struct Loopback_Messages
{
    diag_record_msg_t passed;
    diag_record_msg_t failed;
    const char* name; // in the line of the status
};

constexpr Loopback_Messages fc = {REC_LOOPBACK_PASSED, REC_LOOPBACK_FAILED, "Loopback"};
constexpr Loopback_Messages ethernet = {REC_ETH_PASSED, REC_ETH_FAILED, "EthLoopback"};

bool has_passed(const Outcome& outcome) { return outcome.rc == HXA_STATUS_OK && outcome.loopback.status == 0; }

void report_status(Test_Run& run, const Loopback_Messages& messages, uint32 status)
{
    run.failure(LL_ERR, "%s test run status : %s", messages.name, text_of(status));
}

void report_frames(Test_Run& run, const Loopback_Messages& messages, const Outcome& outcome)
{
    const hxa_diag_loopback_result_t& result = outcome.loopback;
    run.result({messages.failed, LL_ERR}, COMPLETION_FAILED);
    run.failure(LL_INFO, "Tx frames = %u, Rx frames = %u, OSF frames = %u", result.numtxmfrm, result.numrcvfrm, result.numosffrm);
    if (outcome.rc == HXA_STATUS_BADFRMHDR || outcome.rc == HXA_STATUS_BADFRMSZ)
        run.failure(LL_INFO, "Mis-match frame number = %u; Mis-match frame info = %u", result.badfrmnum, result.badfrminf);
    report_status(run, messages, static_cast<uint32>(outcome.rc));
}

// The driver carried the test out, and its result says that something is wrong.
void report_eth_result(Test_Run& run, uint32 status)
{
    if (status == HXA_STATUS_FAILED)
    {
        report_status(run, ethernet, status);
        run.result({REC_UNKNOWN_FAILURE}, COMPLETION_FAILED);
        return;
    }
    run.result({ethernet.failed}, COMPLETION_FAILED);
    report_status(run, ethernet, status);
}

} // namespace

void report_memory(Test_Run& run, const Outcome& outcome)
{
    switch (outcome.rc)
    {
    case HXA_STATUS_OK:
        run.result({REC_MEMORY_PASSED}, COMPLETION_PASSED);
        return;
    case HXA_STATUS_ADAPTER_ENABLED:
        ZMLR_LOG(LL_ERR, "Memory test returned HXA_STATUS_ADAPTER_ENABLED code.");
        ZMLR_LOG(LL_ERR, "Memory test run status : %s", text_of(outcome.memory.status));
        run.record_failure(REC_MEMORY_FAILED);
        return;
    default:
        run.result({REC_MEMORY_FAILED}, COMPLETION_FAILED);
        log_memory_failure(outcome.memory);
    }
}

void report_loopback(Test_Run& run, const Outcome& outcome)
{
    if (has_passed(outcome))
        run.result({fc.passed}, COMPLETION_PASSED);
    else
        report_frames(run, fc, outcome);
}

void report_eth_loopback(Test_Run& run, const Outcome& outcome)
{
    if (has_passed(outcome))
        run.result({ethernet.passed}, COMPLETION_PASSED);
    else if (outcome.rc != HXA_STATUS_OK)
        report_frames(run, ethernet, outcome);
    else
        report_eth_result(run, outcome.loopback.status);
}

void report_pci_loopback(Test_Run& run, const Outcome& outcome)
{
    if (outcome.rc == HXA_STATUS_OK)
    {
        run.result({REC_PCI_PASSED}, COMPLETION_PASSED);
        return;
    }
    run.failure(LL_ERR, "PCILoopback test run status : %s", text_of(static_cast<uint32>(outcome.rc)));
    run.result({REC_PCI_FAILED}, COMPLETION_FAILED);
}

} // namespace zmlr
