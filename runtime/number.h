// Numbers and truth values from text and to text, independent of the process's locale.
#pragma once

#include "runtime/types.h"

#include <cstddef>

namespace zmlr
{

// Text to number: 0, or -1 (and nothing written) when the whole text is not one number of the type. A null text is none.
//
// Unsigned: 1 to 20 decimal digits, or "0x" or "0X" and 1 to 16 hexadecimal digits, of which A-F in upper case only.
// Signed: the same after an optional sign. Real: an optional sign, digits or none, a point, digits, and perhaps "e" or "E",
// an optional sign and digits; a magnitude too large for the type becomes infinity, one too small zero.
int str_to_boolean(const char* text, boolean& x); // "true" or "false" in any case
int str_to_uint8(const char* text, uint8& x);
int str_to_sint8(const char* text, sint8& x);
int str_to_uint16(const char* text, uint16& x);
int str_to_sint16(const char* text, sint16& x);
int str_to_uint32(const char* text, uint32& x);
int str_to_sint32(const char* text, sint32& x);
int str_to_uint64(const char* text, uint64& x);
int str_to_sint64(const char* text, sint64& x);
int str_to_real32(const char* text, real32& x);
int str_to_real64(const char* text, real64& x);

// Number to text: decimal digits, after a "-" if negative, and a terminating zero. The result is the first character, which
// lies somewhere in the buffer or in static memory; `size` receives the length.
inline constexpr std::size_t number_text_size = 22;
const char* uint64_to_str(char (&buffer)[number_text_size], uint64 x, uint32& size);
const char* sint64_to_str(char (&buffer)[number_text_size], sint64 x, uint32& size);
const char* uint8_to_str(char (&buffer)[number_text_size], uint8 x, uint32& size);
const char* sint8_to_str(char (&buffer)[number_text_size], sint8 x, uint32& size);
const char* uint16_to_str(char (&buffer)[number_text_size], uint16 x, uint32& size);
const char* sint16_to_str(char (&buffer)[number_text_size], sint16 x, uint32& size);
const char* uint32_to_str(char (&buffer)[number_text_size], uint32 x, uint32& size);
const char* sint32_to_str(char (&buffer)[number_text_size], sint32 x, uint32& size);

// A real as printf's "%f" writes it where the decimal point is a point: all digits before it, six after it; "inf" or "nan".
inline constexpr std::size_t real_text_size = 320; // the largest real has 309 digits before its point
const char* real64_to_str(char (&buffer)[real_text_size], real64 x, uint32& size);

} // namespace zmlr
