// Text for people: rows and members of a tree, through columns that say what is shown of them.
#pragma once

#include "cli/value.h"

#include <span>
#include <string>

namespace hxa
{

struct Column
{
    const char* heading;
    const char* path;      // of the member, as Value::at() takes it
    const char* unit = ""; // behind a value, with the blank before it
};

// One value: "-" when it is null or empty, "yes" or "no", the elements of a list with blanks between them.
std::string cell(const Value& value);

// Headings, a line, and a row for each element; columns of numbers are aligned to the right. Nothing but "none" without elements.
std::string table(const List& rows, std::span<const Column> columns);

// A line for each column: its heading, its value. Those whose value is null are left out.
std::string details(const Value& object, std::span<const Column> columns);

} // namespace hxa
