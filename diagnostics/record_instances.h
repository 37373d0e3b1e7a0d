// The instances of records, and their associations with the elements tested.
#pragma once

#include "diagnostics/record_list.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"

namespace zmlr
{

// What service records and completion records differ by.
struct Record_Kind
{
    const Meta_Class* meta_class;
    const Meta_Class* association;
    const char* caption;
    const char* description;
    uint16 record_type; // CIM_DiagnosticRecord.RecordType
};

extern const Record_Kind service_record_kind;
extern const Record_Kind completion_record_kind;

// One instance for each record, oldest first. The records are copied before the first driver is asked for an element; each class
// of elements that they name is read once. A request for one record leaves the others out.
Instance_Array getDiagnosticRecordInstances(Record_List& records, const Record_Kind& kind, const Inventory_Request& request);

// One association for each record whose element is there, in the same order.
Instance_Array getRecordAppliesToElementInstances(Record_List& records, const Record_Kind& kind,
                                                  const Inventory_Request& request);

} // namespace zmlr
