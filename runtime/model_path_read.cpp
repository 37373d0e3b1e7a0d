#include "runtime/ascii.h"
#include "runtime/features.h"
#include "runtime/model_path.h"
#include "runtime/number.h"

namespace zmlr
{

namespace
{

bool is_identifier(char c, bool first)
{
    const unsigned char lower = ascii::to_lower(c);
    return c == '_' || (lower >= 'a' && lower <= 'z') || (!first && ascii::is_digit(c));
}

class Path_Reader
{
public:
    explicit Path_Reader(const char* path) : _at(path) {}

    bool at_end() const { return *_at == '\0'; }

    bool skip(char c)
    {
        if (*_at != c)
            return false;
        ++_at;
        return true;
    }

    // The identifier at this place, empty when there is none.
    String identifier()
    {
        const char* begin = _at;
        while (is_identifier(*_at, _at == begin))
            ++_at;
        return String(begin, static_cast<std::size_t>(_at - begin));
    }

    // What stands up to the next separator.
    String bare()
    {
        const char* begin = _at;
        while (*_at && *_at != ',')
            ++_at;
        return String(begin, static_cast<std::size_t>(_at - begin));
    }

    bool quoted(String& out)
    {
        if (!skip('"'))
            return false;
        for (; *_at && *_at != '"'; ++_at)
        {
            if (*_at == '\\' && *++_at != '\\' && *_at != '"')
                return false;
            out.append(*_at);
        }
        return skip('"');
    }

    bool character(char16& out)
    {
        if (!skip('\'') || at_end())
            return false;
        out = char16(static_cast<unsigned char>(*_at++));
        return skip('\'');
    }

private:
    const char* _at;
};

template <class T> bool read_bare(Path_Reader& reader, Instance* instance, uint32 at, int (*convert)(const char* text, T& x))
{
    return convert(reader.bare().c_str(), value_at<T>(instance, at)) == 0;
}

bool read_value(Path_Reader& reader, Instance* instance, const Meta_Property* property)
{
    const uint32 at = property->offset;
    switch (static_cast<Type>(property->type))
    {
        // clang-format off
    case BOOLEAN:  return read_bare(reader, instance, at, str_to_boolean);
    case UINT8:    return read_bare(reader, instance, at, str_to_uint8);
    case SINT8:    return read_bare(reader, instance, at, str_to_sint8);
    case UINT16:   return read_bare(reader, instance, at, str_to_uint16);
    case SINT16:   return read_bare(reader, instance, at, str_to_sint16);
    case UINT32:   return read_bare(reader, instance, at, str_to_uint32);
    case SINT32:   return read_bare(reader, instance, at, str_to_sint32);
    case UINT64:   return read_bare(reader, instance, at, str_to_uint64);
    case SINT64:   return read_bare(reader, instance, at, str_to_sint64);
    case REAL32:   return read_bare(reader, instance, at, str_to_real32);
    case REAL64:   return read_bare(reader, instance, at, str_to_real64);
    case CHAR16:   return reader.character(value_at<char16>(instance, at));
    case STRING:   return reader.quoted(value_at<String>(instance, at));
    case DATETIME: return value_at<Datetime>(instance, at).set(reader.bare().c_str());
        // clang-format on
    }
    return false;
}

// Each level of nesting doubles the backslashes before a quote: the depth is at most the logarithm of the path's length.
bool read_reference(Path_Reader& reader, Instance*& slot, const Meta_Class* meta_class)
{
    String path;
    if (slot || !reader.quoted(path))
        return false;
    Ref<Instance> referenced(model_path_to_instance(meta_class, path.c_str()));
    if (!referenced || !is_subclass(meta_class, referenced->meta_class))
        return false;
    slot = referenced.steal();
    return true;
}

bool read_key(Path_Reader& reader, Instance* instance)
{
    const String name = reader.identifier();
    const Meta_Feature* key = find_feature(instance->meta_class, name.c_str());
    if (!key || !is_key(key) || !reader.skip('='))
        return false;
    if (const Meta_Reference* reference = to_single_reference(key))
        return read_reference(reader, reference_of(instance, reference), reference->meta_class);

    const Meta_Property* property = to_property(key);
    if (!property || is_array(property) || !null_of(instance, property) || !read_value(reader, instance, property))
        return false;
    null_of(instance, property) = 0;
    return true;
}

} // namespace

Instance* model_path_to_instance(const Meta_Class* meta_class, const char* path)
{
    check(meta_class != nullptr, "meta_class != 0");
    check(path != nullptr, "path != 0");
    Path_Reader reader(path);
    const Meta_Class* named = find_meta_class(meta_class, reader.identifier().c_str());
    if (!named || !reader.skip('.'))
        return nullptr;

    Ref<Instance> result(create(named, false));
    nullify_properties(result.ptr());
    do
        if (!read_key(reader, result.ptr()))
            return nullptr;
    while (reader.skip(','));
    return reader.at_end() ? result.steal() : nullptr;
}

} // namespace zmlr
