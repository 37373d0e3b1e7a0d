// The debug text of values: how print() and fprint() of instances and of Value write what a property holds.
#pragma once

#include "runtime/types.h"

#include <cstddef>
#include <cstdio>

namespace zmlr
{

// Writes four spaces for each level.
void print_indent(std::FILE* stream, uint32 level);

// Writes the text between double quotes, as C source would hold it: a quote, a backslash and the usual control characters
// with a backslash, every other byte that is not printable ASCII as a backslash and three octal digits.
void print_string(std::FILE* stream, const char* text, std::size_t size);

// Writes the value of a type that lies at the address: booleans "true" or "false", integers in decimal, reals as %f with a point
// in every locale, char16 as 'c' when printable ASCII and as 0xHHHH otherwise, strings as above, datetimes in their 25-character
// form between double quotes.
void print_scalar(std::FILE* stream, Type type, const void* value);

// Writes the Array<> of elements of a type that lies at the address: "{ 1, 2 }", or "{ }" when it is empty.
void print_array(std::FILE* stream, Type element_type, const void* array);

} // namespace zmlr
