// The shape that the procedures of all tests share: take the element out of service, test, put it back, report.
#pragma once

#include "diagnostics/test_run.h"

#include <array>

namespace zmlr
{

// How elements of a kind go out of service and back, and what is noted on the way. Only `is_out` may need memory.
struct Service
{
    bool (*is_out)(const DiagnosticTestInput& input);
    hxa_status_t (*take_out)(const DiagnosticTestInput& input);
    void (*put_back)(const DiagnosticTestInput& input);
    void (*undo)(
        const DiagnosticTestInput& input); // puts back what a refused take_out() took out; null: a refusal does not matter

    Message checking;
    Message was_out;
    Message was_in;
    Message taking_out;
    Message putting_back;
};

// What a test answered.
struct Outcome
{
    hxa_status_t rc = HXA_STATUS_OK;
    hxa_diag_memtest_result_t memory = {};
    hxa_diag_loopback_result_t loopback = {};
};

// The procedure of a kind of test.
struct Procedure
{
    const char* name;
    const Service* service; // null: the element stays in service
    uint64 pause;           // microseconds for the link to settle after each step
    std::array<Message, 2> running;
    void (*test)(const DiagnosticTestInput& input, Outcome& outcome);
    Message evaluating;
    void (*report)(Test_Run& run, const Outcome& outcome);
};

// Runs the test. An element that was in service is back in service, and the job completed, also when an exception leaves.
void carry_out(const Procedure& procedure, Test_Run& run);

} // namespace zmlr
