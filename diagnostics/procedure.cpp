#include "diagnostics/procedure.h"

#include "runtime/trace.h"

#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "DiagnosticHelper";

// Completes the job by whatever way the run ends; made first, so that the element is back by then.
class Completion
{
public:
    explicit Completion(Test_Run& run) : _run(run) {}
    ~Completion() { _run.complete(); }
    Completion(const Completion&) = delete;
    Completion& operator=(const Completion&) = delete;

private:
    Test_Run& _run;
};

// The element while the test needs it out of service. Whatever happens, it goes back where it was.
class Out_Of_Service
{
public:
    Out_Of_Service(const Procedure& procedure, Test_Run& run) : _procedure(procedure), _run(run) {}
    ~Out_Of_Service()
    {
        if (_is_to_go_back)
            _procedure.service->put_back(_run.input());
    }
    Out_Of_Service(const Out_Of_Service&) = delete;
    Out_Of_Service& operator=(const Out_Of_Service&) = delete;

    // False when the element refuses to go, and has to for its test.
    bool take_out();
    void put_back();

private:
    const Procedure& _procedure;
    Test_Run& _run;
    bool _is_to_go_back = false;
};

bool Out_Of_Service::take_out()
{
    if (!_procedure.service)
        return true;
    const Service& service = *_procedure.service;
    _run.note(service.checking);
    if (service.is_out(_run.input()))
    {
        _run.note(service.was_out);
        return true;
    }
    _run.note(service.was_in);
    _run.note(service.taking_out);
    if (service.take_out(_run.input()) != HXA_STATUS_OK && service.undo)
    {
        service.undo(_run.input());
        _run.result({REC_PORT_DISABLE_FAILED, LL_ERR}, COMPLETION_FAILED);
        return false;
    }
    _is_to_go_back = true;
    _run.pause(_procedure.pause);
    return true;
}

void Out_Of_Service::put_back()
{
    if (!_is_to_go_back)
        return;
    _run.note(_procedure.service->putting_back);
    _is_to_go_back = false;
    _procedure.service->put_back(_run.input());
    _run.pause(_procedure.pause);
}

} // namespace

void carry_out(const Procedure& procedure, Test_Run& run)
{
    const Scope_Trace trace(log_source, procedure.name);
    const Completion completion(run);
    Out_Of_Service element(procedure, run);
    if (!element.take_out())
        return;

    for (const Message& message : procedure.running)
    {
        if (message.id != REC_NONE)
            run.note(message);
    }
    Outcome outcome;
    procedure.test(run.input(), outcome);
    run.pause(procedure.pause);
    element.put_back();
    run.complete();
    run.note(procedure.evaluating);
    procedure.report(run, outcome);
}

} // namespace zmlr
