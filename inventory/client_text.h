// Texts that a client sent, on their way into the log and into commands.
#pragma once

#include "runtime/string.h"

namespace zmlr
{

bool has_control_character(const String& text); // those of Unicode

// The text as part of a line of the log: control characters, and bytes that are no UTF-8, become '?'; what is behind the first
// 4,096 bytes is left out.
String log_text(const String& text);

} // namespace zmlr
