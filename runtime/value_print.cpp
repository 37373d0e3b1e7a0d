#include "runtime/instance_print.h"
#include "runtime/print.h"
#include "runtime/value.h"

#include <cstdio>

namespace zmlr
{

namespace
{

void print_instance(std::FILE* stream, const Instance* instance)
{
    if (instance)
        fprint(stream, instance);
    else
        std::fputs("NULL\n", stream);
}

} // namespace

void Value::fprint(std::FILE* stream) const
{
    std::fprintf(stream, "Value\n{\n    type=%s\n    null=%s\n", _type_name(_type), _null ? "true" : "false");
    if (Instance* const* instance = get_if<Instance*>())
        print_instance(stream, *instance);
    else if (const auto* instances = get_if<Array<Instance*>>())
        for (const Instance* element : *instances)
            print_instance(stream, element);
    else if (_type != NONE)
    {
        const bool array = _type >= BOOLEAN_ARRAY;
        print_indent(stream, 1);
        if (array)
            print_array(stream, static_cast<zmlr::Type>(_type - BOOLEAN_ARRAY), content());
        else
            print_scalar(stream, static_cast<zmlr::Type>(_type), content());
        std::fputc('\n', stream);
    }
    std::fputs("}\n", stream);
}

void Value::print() const { fprint(stdout); }

} // namespace zmlr
