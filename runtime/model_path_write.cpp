#include "runtime/features.h"
#include "runtime/model_path.h"
#include "runtime/number.h"

#include <string_view>
#include <utility>

namespace zmlr
{

namespace
{

// Appends what one of the functions of number.h writes.
template <std::size_t N, class Wide>
void append_number(String& out, const char* (*write)(char (&buffer)[N], Wide x, uint32& size), Wide x)
{
    char buffer[N];
    uint32 size = 0;
    const char* text = write(buffer, x, size);
    out.append(text, size);
}

void append_character(String& out, char16 x)
{
    const char text[] = {'\'', static_cast<char>(x.code()), '\''};
    out.append(text, sizeof text);
}

void append_quoted(String& out, const String& text)
{
    out.append('"');
    out.append(text);
    out.append('"');
}

void append_value(String& out, const Instance* instance, const Meta_Property* property)
{
    const uint32 at = property->offset;
    switch (static_cast<Type>(property->type))
    {
        // clang-format off
    case BOOLEAN:  return out.append(value_at<boolean>(instance, at) ? "true" : "false");
    case UINT8:    return append_number(out, uint8_to_str, value_at<uint8>(instance, at));
    case SINT8:    return append_number(out, sint8_to_str, value_at<sint8>(instance, at));
    case UINT16:   return append_number(out, uint16_to_str, value_at<uint16>(instance, at));
    case SINT16:   return append_number(out, sint16_to_str, value_at<sint16>(instance, at));
    case UINT32:   return append_number(out, uint32_to_str, value_at<uint32>(instance, at));
    case SINT32:   return append_number(out, sint32_to_str, value_at<sint32>(instance, at));
    case UINT64:   return append_number(out, uint64_to_str, value_at<uint64>(instance, at));
    case SINT64:   return append_number(out, sint64_to_str, value_at<sint64>(instance, at));
    case REAL32:   return append_number(out, real64_to_str, real64{value_at<real32>(instance, at)});
    case REAL64:   return append_number(out, real64_to_str, value_at<real64>(instance, at));
    case CHAR16:   return append_character(out, value_at<char16>(instance, at));
    case STRING:   return append_quoted(out, value_at<String>(instance, at));
    case DATETIME: return out.append(value_at<Datetime>(instance, at).ascii());
        // clang-format on
    }
}

bool append_path(String& out, const Instance* instance);

bool append_reference(String& out, const Instance* referenced)
{
    String path;
    if (!referenced || !append_path(path, referenced))
        return false;
    out.append('"');
    for (const char c : std::string_view(path.c_str(), path.size()))
    {
        if (c == '"')
            out.append('\\');
        out.append(c);
    }
    out.append('"');
    return true;
}

bool append_key(String& out, const Instance* instance, const Meta_Feature* key)
{
    out.append(key->name);
    out.append('=');
    if (const Meta_Reference* reference = to_single_reference(key))
        return append_reference(out, reference_of(instance, reference));

    const Meta_Property* property = to_property(key);
    if (!property || is_array(property) || null_of(instance, property))
        return false;
    append_value(out, instance, property);
    return true;
}

bool append_path(String& out, const Instance* instance)
{
    check_inst(instance);
    out.append(record_of(instance)->name);
    char separator = '.';
    for (const Meta_Feature* feature : features_of(instance))
    {
        if (!is_key(feature))
            continue;
        out.append(separator);
        if (!append_key(out, instance, feature))
            return false;
        separator = ',';
    }
    return separator == ',';
}

} // namespace

int instance_to_model_path(const Instance* instance, String& out)
{
    check_inst(instance);
    String path; // `out` may be a key of the instance
    const bool whole = append_path(path, instance);
    out = std::move(path);
    return whole ? 0 : -1;
}

} // namespace zmlr
