// One run of a test, as its procedure sees it: what is tested, and how it is told what happens.
#pragma once

#include "diagnostics/record_list.h"
#include "diagnostics/record_messages.h"
#include "diagnostics/test_catalogue.h"
#include "diagnostics/tested_element.h"
#include "hxal/hxal.h"
#include "runtime/log.h"
#include "runtime/string.h"

namespace zmlr
{

class DiagnosticHelper;

// The parameters of a run.
struct DiagnosticTestInput
{
    const Diagnostic_Test* test = nullptr;
    String jobLabel; // the job's name
    Tested_Element element;
    int adapterId = 0;        // of the memory test: the adapter's index
    hxal_t* handle = nullptr; // the IOC under test
    uint32 speed = 0;         // Gbit/s, of an FC loopback; 0: any
    uint32 pattern = 0xB5B5B5B5;
};

// A message and the level at which it is logged when it is recorded.
struct Message
{
    diag_record_msg_t id = REC_NONE;
    Log_Level level = LL_INFO;
};

class Test_Run
{
public:
    Test_Run(DiagnosticTestInput parameters, DiagnosticHelper& helper);

    const DiagnosticTestInput& input() const { return _input; }

    // Log a text and leave a record with it: a service record of what is done, a completion record of how it went.
    void note(Message message);
    void result(Message message, diag_compl_record_state_t state);
    [[gnu::format(printf, 3, 4)]] void failure(Log_Level level, const char* format, ...);

    // Leaves a completion record without a line of the log.
    void record_failure(diag_record_msg_t message);

    // Waits, unless the process ends: then it is over in a tenth of a second.
    void pause(uint64 usec);

    // Marks the job as completed, the first time only: afterwards the name may be that of the next run's job. Needs no memory.
    void complete() noexcept;

private:
    DiagnosticTestInput _input;
    DiagnosticHelper& _helper;
    bool _is_complete = false;
};

} // namespace zmlr
