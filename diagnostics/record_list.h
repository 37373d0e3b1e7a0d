// What runs leave: the newest service records, and the newest completion records.
#pragma once

#include "diagnostics/tested_element.h"
#include "runtime/datetime.h"
#include "runtime/string.h"

#include <atomic>
#include <cstddef>
#include <mutex>
#include <vector>

namespace zmlr
{

// CIM_DiagnosticCompletionRecord.CompletionState
enum diag_compl_record_state_t : uint16
{
    COMPLETION_NONE = 0, // of a service record
    COMPLETION_PASSED = 2,
    COMPLETION_FAILED = 5
};

struct DiagnosticRecord
{
    String instanceId; // the record's key
    Datetime creationTime;
    String recordData;  // the message
    String serviceName; // the full test name
    Tested_Element element;
    diag_compl_record_state_t completionState = COMPLETION_NONE;
};

// Draws the numbers of records, from 1, for all lists.
using Record_Counter = std::atomic<uint32>;

// A bounded list, oldest record first. Safe from any thread.
class Record_List
{
public:
    static constexpr std::size_t max_records = 100;

    // Gives the record its key, "label:number", and its time, and appends it; the oldest one makes room.
    void add(DiagnosticRecord record, const String& label, Record_Counter& counter);

    std::vector<DiagnosticRecord> copy();

private:
    std::mutex _mutex;
    std::vector<DiagnosticRecord> _records;
};

} // namespace zmlr
