// Texts on their way from the driver to a property: bounded by their field, and fit for an XML 1.0 document.
#pragma once

#include "runtime/string.h"

#include <cstddef>

namespace zmlr
{

// The text in `field`, up to its terminator or the field's end. A byte that does not come through an XML 1.0 document encoded
// in UTF-8 as it is (a control character other than tab and line feed; a byte of no valid sequence; a code point that XML
// excludes) becomes '?'. Readers take a carriage return for a line feed: a key with one could not be sent back.
String property_text(const char* field, std::size_t size);
template <std::size_t N> String property_text(const char (&field)[N]) { return property_text(field, N); }

// Copies the text of a field into a record's field and terminates it; a text that does not fit is cut.
void copy_text(char* out, std::size_t out_size, const char* field, std::size_t size);
template <std::size_t N, std::size_t M> void copy_text(char (&out)[N], const char (&field)[M]) { copy_text(out, N, field, M); }

} // namespace zmlr
