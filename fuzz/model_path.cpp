// Any text read as the path of a class with keys of every kind: it is refused, or the path of what it gives reads back to the
// same object.
#include "runtime/model_path.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <iterator>
#include <string>

// The record is laid out by the compiler and located by offset, as generated ones are.
#pragma GCC diagnostic ignored "-Winvalid-offsetof"

namespace
{

using namespace zmlr;

// A key of every type; Linked has a key reference to such an object, perhaps to a Linked one.
struct Values : Instance
{
    Property<boolean> B;
    Property<uint8> U8;
    Property<sint8> S8;
    Property<uint16> U16;
    Property<sint16> S16;
    Property<uint32> U32;
    Property<sint32> S32;
    Property<uint64> U64;
    Property<sint64> S64;
    Property<real32> R32;
    Property<real64> R64;
    Property<char16> C;
    Property<String> S;
    Property<Datetime> D;

    static const Meta_Class static_meta_class;
};

struct Linked : Values
{
    Values* R;

    static const Meta_Class static_meta_class;
};

constexpr Meta_Property key(const char* name, Type type, std::size_t offset)
{
    return {
        {{0}, Flag_Property | Flag_Key, name, nullptr, 0}, static_cast<uint16>(type), 0, static_cast<uint32>(offset), nullptr};
}

constexpr Meta_Property properties[] = {
    key("B", BOOLEAN, offsetof(Values, B)),    key("U8", UINT8, offsetof(Values, U8)),
    key("S8", SINT8, offsetof(Values, S8)),    key("U16", UINT16, offsetof(Values, U16)),
    key("S16", SINT16, offsetof(Values, S16)), key("U32", UINT32, offsetof(Values, U32)),
    key("S32", SINT32, offsetof(Values, S32)), key("U64", UINT64, offsetof(Values, U64)),
    key("S64", SINT64, offsetof(Values, S64)), key("R32", REAL32, offsetof(Values, R32)),
    key("R64", REAL64, offsetof(Values, R64)), key("C", CHAR16, offsetof(Values, C)),
    key("S", STRING, offsetof(Values, S)),     key("D", DATETIME, offsetof(Values, D)),
};
constexpr Meta_Reference reference = {
    {{0}, Flag_Reference | Flag_Key, "R", nullptr, 0}, 0, &Values::static_meta_class, offsetof(Linked, R)};

constexpr const Meta_Feature* features[] = {&properties[0],  &properties[1],  &properties[2],  &properties[3],  &properties[4],
                                            &properties[5],  &properties[6],  &properties[7],  &properties[8],  &properties[9],
                                            &properties[10], &properties[11], &properties[12], &properties[13], &reference};

constexpr uint32 num_properties = std::size(properties);
constexpr const Meta_Class* classes[] = {&Values::static_meta_class, &Linked::static_meta_class};
constexpr Meta_Repository repository = {classes, 2};

Linked* as_linked(Values* values)
{
    return values->meta_class == &Linked::static_meta_class ? static_cast<Linked*>(values) : nullptr;
}

// Gives every key that the path left out a value that can be written. True when all must read back as they are: a real, a
// datetime, a text with quotes or backslashes, and a reference within a reference need not.
bool complete(Values* values, int depth)
{
    const String& text = values->S.value;
    bool exact = values->R32.null && values->R64.null && values->D.null && depth < 2 && text.find('"') == String::npos &&
                 text.find('\\') == String::npos;
    de_nullify_properties(values);
    if (values->C.value.code() == 0)
        values->C.value = char16(u'c');
    Linked* linked = as_linked(values);
    if (!linked)
        return exact;
    if (!linked->R)
        linked->R = create<Values>(false);
    return complete(linked->R, depth + 1) && exact;
}

} // namespace

constinit const Meta_Class Values::static_meta_class = {
    {{{0}, Flag_Class, "Values", nullptr, 0}, features, num_properties, sizeof(Values)},
    nullptr,
    nullptr,
    num_properties,
    &repository};
constinit const Meta_Class Linked::static_meta_class = {
    {{{0}, Flag_Class, "Linked", nullptr, 0}, features, num_properties + 1, sizeof(Linked)},
    nullptr,
    &Values::static_meta_class,
    num_properties + 1,
    &repository};

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string text(reinterpret_cast<const char*>(data), size);
    const Ref<Instance> read(model_path_to_instance(&Linked::static_meta_class, text.c_str()));
    if (!read)
        return 0;

    const bool exact = complete(static_cast<Values*>(read.ptr()), 0);
    String path;
    if (instance_to_model_path(read.ptr(), path) != 0)
        std::abort();
    const Ref<Instance> again(model_path_to_instance(&Linked::static_meta_class, path.c_str()));
    if (exact && !(again && identical(read.ptr(), again.ptr())))
        std::abort();
    return 0;
}
