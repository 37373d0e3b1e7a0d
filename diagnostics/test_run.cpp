#include "diagnostics/test_run.h"

#include "diagnostics/diagnostic_helper.h"
#include "runtime/time.h"

#include <cstdarg>
#include <cstdio>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

} // namespace

Test_Run::Test_Run(DiagnosticTestInput parameters, DiagnosticHelper& helper) : _input(std::move(parameters)), _helper(helper) {}

void Test_Run::note(Message message)
{
    const char* text = ProviderUtil::getRecordData(message.id);
    ZMLR_LOG(message.level, "%s", text);
    _helper.generateDiagnosticRecord(text, _input, COMPLETION_NONE);
}

void Test_Run::result(Message message, diag_compl_record_state_t state)
{
    const char* text = ProviderUtil::getRecordData(message.id);
    ZMLR_LOG(message.level, "%s", text);
    _helper.generateDiagnosticRecord(text, _input, state);
}

void Test_Run::failure(Log_Level level, const char* format, ...)
{
    char text[256];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    ZMLR_LOG(level, "%s", text);
    _helper.generateDiagnosticRecord(text, _input, COMPLETION_FAILED);
}

void Test_Run::record_failure(diag_record_msg_t message)
{
    _helper.generateDiagnosticRecord(ProviderUtil::getRecordData(message), _input, COMPLETION_FAILED);
}

void Test_Run::pause(uint64 usec)
{
    constexpr uint64 slice = 100 * Time::MSEC;
    for (uint64 slept = 0; slept < usec && !_helper.jobs().is_ending(); slept += slice)
        Time::sleep(slice);
}

void Test_Run::complete() noexcept
{
    if (!std::exchange(_is_complete, true))
        _helper.jobs().updateJobState(_input.jobLabel);
}

} // namespace zmlr
