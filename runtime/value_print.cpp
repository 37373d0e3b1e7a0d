#include "runtime/instance_print.h"
#include "runtime/print.h"
#include "runtime/value.h"

#include <cstdio>
#include <variant>

namespace zmlr
{

namespace
{

void print_content(std::FILE*, std::monostate) {}

void print_content(std::FILE* stream, Instance* instance)
{
    if (instance)
        fprint(stream, instance);
    else
        std::fputs("NULL\n", stream);
}

void print_content(std::FILE* stream, const Array<Instance*>& instances)
{
    for (Instance* instance : instances)
        print_content(stream, instance);
}

template <class T> void print_content(std::FILE* stream, const Array<T>& array)
{
    print_indent(stream, 1);
    print_array(stream, type_code<T>::value, &array);
    std::fputc('\n', stream);
}

template <class T> void print_content(std::FILE* stream, const T& scalar)
{
    print_indent(stream, 1);
    print_scalar(stream, type_code<T>::value, &scalar);
    std::fputc('\n', stream);
}

} // namespace

void Value::fprint(std::FILE* stream) const
{
    std::fprintf(stream, "Value\n{\n    type=%s\n    null=%s\n", _type_name(_type), _null ? "true" : "false");
    std::visit([stream](const auto& content) { print_content(stream, content); }, _content);
    std::fputs("}\n", stream);
}

void Value::print() const { fprint(stdout); }

} // namespace zmlr
