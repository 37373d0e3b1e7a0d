#include "operation_table.h"

#include <cstring>

std::vector<std::uint8_t> bytes_of(const char* text) { return {text, text + std::strlen(text)}; }
