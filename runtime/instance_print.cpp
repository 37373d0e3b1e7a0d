#include "runtime/instance_print.h"

#include "runtime/features.h"
#include "runtime/print.h"

namespace zmlr
{

namespace
{

void print_block(std::FILE* stream, const Instance* instance, const char* member, uint32 level);

void print_property(std::FILE* stream, const Instance* instance, const Meta_Property* property)
{
    const auto type = static_cast<Type>(property->type);
    const void* value = address_of(instance, property->offset);
    std::fprintf(stream, "%s %s%s = ", type_name[type], property->name, is_array(property) ? "[]" : "");
    if (null_of(instance, property))
        std::fputs("NULL", stream);
    else if (is_array(property))
        print_array(stream, type, value);
    else
        print_scalar(stream, type, value);
    std::fputs(";\n", stream);
}

void print_references(std::FILE* stream, const Instance* instance, const Meta_Reference* array, uint32 level)
{
    std::fprintf(stream, "%s %s[] =", array->meta_class->name, array->name);
    if (null_of(instance, array))
    {
        std::fputs(" NULL;\n", stream);
        return;
    }

    std::fputc('\n', stream);
    print_indent(stream, level);
    std::fputs("{\n", stream);
    for (const Instance* element : references_of(instance, array))
    {
        print_indent(stream, level + 1);
        if (element)
            print_block(stream, element, array->name, level + 1);
        else
            std::fputs("NULL\n", stream);
    }
    print_indent(stream, level);
    std::fputs("};\n", stream);
}

void print_feature(std::FILE* stream, const Instance* instance, const Meta_Feature* feature, uint32 level)
{
    if (is_method(feature))
        return;
    print_indent(stream, level);
    if (const Meta_Property* property = to_property(feature))
    {
        print_property(stream, instance, property);
    }
    else if (const Meta_Reference* array = to_array_reference(feature))
    {
        print_references(stream, instance, array, level);
    }
    else
    {
        const Meta_Reference* single = as_reference(feature);
        if (const Instance* referenced = reference_of(instance, single))
            print_block(stream, referenced, single->name, level);
        else
            std::fprintf(stream, "%s %s = NULL;\n", single->meta_class->name, single->name);
    }
}

// The header stands where the caller has indented to; a top level block has no member name.
void print_block(std::FILE* stream, const Instance* instance, const char* member, uint32 level)
{
    check_inst(instance);
    if (member)
        std::fprintf(stream, "%s %s =\n", record_of(instance)->name, member);
    else
        std::fprintf(stream, "%s\n", record_of(instance)->name);
    print_indent(stream, level);
    std::fputs("{\n", stream);
    if (!instance->__name_space.empty())
    {
        print_indent(stream, level + 1);
        std::fprintf(stream, "string __name_space = \"%s\";\n", instance->__name_space.c_str());
    }
    for (const Meta_Feature* feature : features_of(instance))
        print_feature(stream, instance, feature, level + 1);
    print_indent(stream, level);
    std::fputs("}\n", stream);
}

} // namespace

void fprint(std::FILE* stream, const Instance* instance)
{
    check_inst(instance);
    print_block(stream, instance, nullptr, 0);
}

void print(const Instance* instance)
{
    check_inst(instance);
    fprint(stdout, instance);
}

} // namespace zmlr
