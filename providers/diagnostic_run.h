// The row of a class of diagnostic tests: what its tests run on, and who starts them.
#pragma once

#include "diagnostics/diagnostic_helper.h"
#include "runtime/instance.h"

namespace zmlr
{

struct CIM_ConcreteJob;

// A class of elements that tests run on, and the line of the log, if any, for a test of one of them.
struct Testable
{
    const Meta_Class* meta_class;
    const char* remark = nullptr;
};

struct Diagnostic_Run
{
    const Meta_Class* meta_class; // of the tests
    Testable elements[2];
    Started (DiagnosticHelper::*start)(const String& address, const String& test_name);
};

// Starts the test with this name on the element, when it is one of the row's: the code of the start, and with RUN_STARTED the
// job, whose one count the caller owns.
uint32 run_diagnostic(const Diagnostic_Run& row, const String& test_name, const Instance* element, CIM_ConcreteJob*& job,
                      const char* log_source);

} // namespace zmlr
