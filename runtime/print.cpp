#include "runtime/print.h"

#include "runtime/array.h"
#include "runtime/datetime.h"
#include "runtime/number.h"
#include "runtime/string.h"

#include <cinttypes>
#include <string_view>

namespace zmlr
{

namespace
{

bool is_printable(unsigned code) { return code >= ' ' && code <= '~'; }

void print(std::FILE* stream, boolean x) { std::fputs(x ? "true" : "false", stream); }
void print(std::FILE* stream, uint32 x) { std::fprintf(stream, "%u", x); }
void print(std::FILE* stream, sint32 x) { std::fprintf(stream, "%d", x); }
void print(std::FILE* stream, uint64 x) { std::fprintf(stream, "%" PRIu64, x); }
void print(std::FILE* stream, sint64 x) { std::fprintf(stream, "%" PRId64, x); }
void print(std::FILE* stream, uint8 x) { print(stream, uint32{x}); }
void print(std::FILE* stream, sint8 x) { print(stream, sint32{x}); }
void print(std::FILE* stream, uint16 x) { print(stream, uint32{x}); }
void print(std::FILE* stream, sint16 x) { print(stream, sint32{x}); }

void print(std::FILE* stream, real64 x)
{
    char buffer[real_text_size];
    uint32 size = 0;
    std::fputs(real64_to_str(buffer, x, size), stream);
}

void print(std::FILE* stream, real32 x) { print(stream, real64{x}); }

void print(std::FILE* stream, char16 x)
{
    if (is_printable(x.code()))
        std::fprintf(stream, "'%c'", x.code());
    else
        std::fprintf(stream, "0x%04X", x.code());
}

void print(std::FILE* stream, const String& x) { print_string(stream, x.c_str(), x.size()); }

void print(std::FILE* stream, const Datetime& x)
{
    char text[Datetime::text_size];
    x.ascii(text);
    std::fprintf(stream, "\"%s\"", text);
}

// How a value and an array of values of one C++ type are written.
struct Printer
{
    void (*scalar)(std::FILE* stream, const void* value);
    void (*array)(std::FILE* stream, const void* array);
};

template <class T> void scalar(std::FILE* stream, const void* value) { print(stream, *static_cast<const T*>(value)); }

template <class T> void array(std::FILE* stream, const void* value)
{
    const char* separator = "{ ";
    for (const T& element : *static_cast<const Array<T>*>(value))
    {
        std::fputs(separator, stream);
        print(stream, element);
        separator = ", ";
    }
    std::fputs(*separator == '{' ? "{ }" : " }", stream);
}

template <class T> constexpr Printer printer = {scalar<T>, array<T>};

constexpr Printer printers[num_types] = {
    printer<boolean>, printer<uint8>,  printer<sint8>,  printer<uint16>, printer<sint16>, printer<uint32>, printer<sint32>,
    printer<uint64>,  printer<sint64>, printer<real32>, printer<real64>, printer<char16>, printer<String>, printer<Datetime>,
};

} // namespace

void print_indent(std::FILE* stream, uint32 level) { std::fprintf(stream, "%*s", static_cast<int>(level * 4), ""); }

void print_string(std::FILE* stream, const char* text, std::size_t size)
{
    constexpr std::string_view special = "\"\\\a\b\f\n\r\t\v";
    constexpr std::string_view letters = "\"\\abfnrtv";
    std::fputc('"', stream);
    for (const char c : std::string_view(text, size))
    {
        const auto code = static_cast<unsigned char>(c);
        if (const std::size_t i = special.find(c); i != special.npos)
            std::fprintf(stream, "\\%c", letters[i]);
        else if (is_printable(code))
            std::fputc(c, stream);
        else
            std::fprintf(stream, "\\%03o", code);
    }
    std::fputc('"', stream);
}

void print_scalar(std::FILE* stream, Type type, const void* value) { printers[type].scalar(stream, value); }
void print_array(std::FILE* stream, Type element_type, const void* array) { printers[element_type].array(stream, array); }

} // namespace zmlr
