// JSON text of a tree. json.cpp alone sees the JSON library.
#pragma once

#include "cli/value.h"

namespace hxa
{

// Indented over many lines, or all on one; with a newline at the end.
std::string json_text(const Value& value);
std::string json_line(const Value& value);

} // namespace hxa
