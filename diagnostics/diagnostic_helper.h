// DiagnosticHelper: the tests, their runs, and what runs leave: jobs and records.
#pragma once

#include "diagnostics/job_list.h"
#include "diagnostics/procedure.h"
#include "diagnostics/record_list.h"
#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "runtime/string.h"

namespace zmlr
{

// What RunDiagnostic returns.
enum Run_Code : uint32
{
    RUN_NOT_SUPPORTED = 1,
    RUN_FAILED = 4, // another job runs, there is no such element, or no thread could be made
    RUN_INVALID_PARAMETER = 5,
    RUN_STARTED = 4096
};

struct Started
{
    Ref<Instance> job; // names the job; null when none was started
    Run_Code code;
};

// One object for the module, safe from any thread. It holds the latest job and the newest records.
class DiagnosticHelper
{
public:
    static DiagnosticHelper& getDiagnosticHelperObject();

    // The class's instances: tests, the software identity, jobs, records and what associates these with the elements tested.
    // None, with a log line, when there are no adapters or the class is none of these. Elements are read from the adapters, each
    // class of them once.
    Instance_Array getInstancesByClass(classId_t id, const Inventory_Request& request);

    // Start a test on the element with this address on a thread of its own; the job tells how far it is. The name is the
    // test's full name; a class with one test does not look at it.
    Started runMemoryTest(const String& address, const String& test_name);
    Started runLoopbackTest(const String& address, const String& test_name);
    Started runPCILoopbackTest(const String& address, const String& test_name);
    Started runEthLoopbackTest(const String& address, const String& test_name);

    // Leaves a record of a run: a service record without a completion state, else a completion record.
    void generateDiagnosticRecord(const String& message, const DiagnosticTestInput& input, diag_compl_record_state_t state);

    Job_List& jobs() { return _jobs; }
    Record_List& service_records() { return _service_records; }
    Record_List& completion_records() { return _completion_records; }

private:
    DiagnosticHelper() = default;
    Started start(DiagnosticTestInput input, const Procedure& procedure);

    Job_List _jobs;
    Record_List _service_records;
    Record_List _completion_records;
    Record_Counter _record_counter = 0;
};

} // namespace zmlr
