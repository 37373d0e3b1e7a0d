#include "diagnostics/record_list.h"

#include <cstdio>
#include <utility>

namespace zmlr
{

// The number is drawn under the lock: the last records of one run and the first ones of the next come at the same time, and keys
// rise along the list all the same.
void Record_List::add(DiagnosticRecord record, const String& label, Record_Counter& counter)
{
    const std::lock_guard guard(_mutex);
    char id[50] = {};
    std::snprintf(id, sizeof id, "%s:%u", label.c_str(), ++counter);
    record.instanceId = id;
    record.creationTime = Datetime::now();
    if (_records.size() == max_records)
        _records.erase(_records.begin());
    _records.push_back(std::move(record));
}

std::vector<DiagnosticRecord> Record_List::copy()
{
    const std::lock_guard guard(_mutex);
    return _records;
}

} // namespace zmlr
