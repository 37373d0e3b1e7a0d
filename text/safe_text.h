// Texts that clients, drivers and devices wrote, on their way to a person: into the log, onto a terminal.
#pragma once

#include <string>
#include <string_view>

namespace text
{

// Whether the text holds a character that steers what shows it: a control character (ISO/IEC 6429; tab and line breaks too), or
// one of Unicode that breaks lines, hides, or turns the direction of writing.
bool holds_steering(std::string_view text);

// The text with "?" for each such character and for each byte that is part of none: valid UTF-8. The control characters of ASCII
// that are named in `kept` stay.
std::string safe_text(std::string_view text, std::string_view kept = {});

} // namespace text
