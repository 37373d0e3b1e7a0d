#include "tests/cmpi/test_classes.h"

#include <cstddef>
#include <iterator>

// Records are laid out by the compiler and located by offset, as generated ones are.
#pragma GCC diagnostic ignored "-Winvalid-offsetof"

namespace test
{

namespace
{

constexpr Meta_Property property(Type type, const char* name, std::size_t offset, bool array = false, uint32 flags = 0)
{
    return {{{0}, Flag_Property | flags, name, nullptr, 0},
            static_cast<uint16>(type),
            static_cast<sint16>(array ? -1 : 0),
            static_cast<uint32>(offset),
            nullptr};
}

constexpr Meta_Reference reference(const char* name, std::size_t offset, bool array = false, uint32 flags = 0)
{
    return {{{0}, Flag_Reference | flags, name, nullptr, 0},
            static_cast<uint16>(array),
            &Test_Thing::static_meta_class,
            static_cast<uint32>(offset)};
}

// clang-format off
constexpr Meta_Property thing_properties[] = {
    property(STRING,   "Name",     offsetof(Test_Thing, Name), false, Flag_Key),
    property(BOOLEAN,  "Boolean",  offsetof(Test_Thing, Boolean)),
    property(UINT8,    "Uint8",    offsetof(Test_Thing, Uint8)),
    property(SINT8,    "Sint8",    offsetof(Test_Thing, Sint8)),
    property(UINT16,   "Uint16",   offsetof(Test_Thing, Uint16)),
    property(SINT16,   "Sint16",   offsetof(Test_Thing, Sint16)),
    property(UINT32,   "Uint32",   offsetof(Test_Thing, Uint32)),
    property(SINT32,   "Sint32",   offsetof(Test_Thing, Sint32)),
    property(UINT64,   "Uint64",   offsetof(Test_Thing, Uint64)),
    property(SINT64,   "Sint64",   offsetof(Test_Thing, Sint64)),
    property(REAL32,   "Real32",   offsetof(Test_Thing, Real32)),
    property(REAL64,   "Real64",   offsetof(Test_Thing, Real64)),
    property(CHAR16,   "Char16",   offsetof(Test_Thing, Char16)),
    property(DATETIME, "When",     offsetof(Test_Thing, When)),
    property(BOOLEAN,  "Booleans", offsetof(Test_Thing, Booleans), true),
    property(UINT8,    "Uint8s",   offsetof(Test_Thing, Uint8s),   true),
    property(SINT64,   "Sint64s",  offsetof(Test_Thing, Sint64s),  true),
    property(CHAR16,   "Char16s",  offsetof(Test_Thing, Char16s),  true),
    property(STRING,   "Strings",  offsetof(Test_Thing, Strings),  true),
    property(DATETIME, "Whens",    offsetof(Test_Thing, Whens),    true),
};
// clang-format on
constexpr uint32 num_thing_properties = std::size(thing_properties);

constexpr Meta_Property link_note = property(STRING, "Note", offsetof(Test_Link, Note));
constexpr Meta_Reference link_references[] = {
    reference("Antecedent", offsetof(Test_Link, Antecedent), false, Flag_Key),
    reference("Dependent", offsetof(Test_Link, Dependent), false, Flag_Key),
    reference("Detail", offsetof(Test_Link, Detail), false, Flag_EmbeddedInstance),
    reference("Others", offsetof(Test_Link, Others), true, 0),
    reference("Details", offsetof(Test_Link, Details), true, Flag_EmbeddedInstance),
};

constexpr uint32 in_out = Flag_In | Flag_Out;
// clang-format off
constexpr Meta_Property convert_properties[] = {
    property(UINT8,  "Level",        offsetof(Test_Disk_Convert_method, Level),        false, Flag_In),
    property(STRING, "Texts",        offsetof(Test_Disk_Convert_method, Texts),        true,  Flag_In),
    property(SINT64, "Count",        offsetof(Test_Disk_Convert_method, Count),        false, in_out),
    property(STRING, "Answer",       offsetof(Test_Disk_Convert_method, Answer),       false, Flag_Out),
    property(UINT16, "Numbers",      offsetof(Test_Disk_Convert_method, Numbers),      true,  Flag_Out),
    property(STRING, "return_value", offsetof(Test_Disk_Convert_method, return_value), false, Flag_Out),
};
constexpr Meta_Reference convert_references[] = {
    reference("Partner", offsetof(Test_Disk_Convert_method, Partner), false, Flag_In),
    reference("Others",  offsetof(Test_Disk_Convert_method, Others),  true,  Flag_In),
    reference("Found",   offsetof(Test_Disk_Convert_method, Found),   false, Flag_Out),
};
// clang-format on
constexpr const Meta_Feature* convert_features[] = {&convert_properties[0], &convert_properties[1], &convert_references[0],
                                                    &convert_references[1], &convert_properties[2], &convert_properties[3],
                                                    &convert_properties[4], &convert_references[2], &convert_properties[5]};

constexpr Meta_Property reset_return_value =
    property(UINT32, "return_value", offsetof(Test_Disk_Reset_method, return_value), false, Flag_Out);
constexpr const Meta_Feature* reset_features[] = {&reset_return_value};

constexpr Meta_Property alert_properties[] = {
    property(STRING, "Message", offsetof(Test_Alert, Message)),
    property(STRING, "Texts", offsetof(Test_Alert, Texts), true),
};
constexpr const Meta_Feature* alert_features[] = {&alert_properties[0], &alert_properties[1]};

constexpr Meta_Reference odd = {{{0}, 0, "Odd", nullptr, 0}, 0, &Test_Thing::static_meta_class, offsetof(Test_Odd, Odd)};
constexpr const Meta_Feature* odd_features[] = {&odd};

// A thing's properties, and behind them a disk's methods.
constexpr uint32 num_disk_features = num_thing_properties + 2;
struct Disk_Features
{
    const Meta_Feature* features[num_disk_features];
    constexpr Disk_Features() : features()
    {
        for (uint32 i = 0; i < num_thing_properties; ++i)
            features[i] = &thing_properties[i];
        features[num_thing_properties] = &Test_Disk_Convert_method::static_meta_class;
        features[num_thing_properties + 1] = &Test_Disk_Reset_method::static_meta_class;
    }
};

constexpr Disk_Features disk_features;
constexpr const Meta_Feature* link_features[] = {&link_references[0], &link_references[1], &link_note,
                                                 &link_references[2], &link_references[3], &link_references[4]};
constexpr Meta_Feature_Local locals[num_disk_features] = {};

// A class whose count is not 0 is counted: one is the class itself.
constexpr Meta_Class make(uint32 flags, const char* name, const Meta_Feature* const* features, uint32 count, std::size_t size,
                          const Meta_Class* super, uint32 num_keys)
{
    return {{{{1}, Flag_Class | flags, name, nullptr, 0}, features, count, static_cast<uint32>(size)},
            locals,
            super,
            num_keys,
            &repository};
}

extern const Meta_Class relation;
extern const Meta_Class strong_link;

constexpr const Meta_Class* classes[] = {&Test_Thing::static_meta_class,
                                         &Test_Disk::static_meta_class,
                                         &Test_Link::static_meta_class,
                                         &Test_Alert::static_meta_class,
                                         &relation,
                                         &strong_link};

} // namespace

// What Test_Link derives from and what derives from it.
namespace
{
constinit const Meta_Class relation = make(Flag_Association, "Test_Relation", nullptr, 0, sizeof(Instance), nullptr, 0);
constinit const Meta_Class strong_link = make(Flag_Association, "Test_Strong_Link", link_features, std::size(link_features),
                                              sizeof(Test_Link), &Test_Link::static_meta_class, 2);
} // namespace

constinit const Meta_Method Test_Disk_Convert_method::static_meta_class = {
    {{{0}, Flag_Method, "Convert", nullptr, 0}, convert_features, std::size(convert_features), sizeof(Test_Disk_Convert_method)},
    STRING};
constinit const Meta_Method Test_Disk_Reset_method::static_meta_class = {
    {{{0}, Flag_Method | Flag_Static, "Reset", nullptr, 0}, reset_features, 1, sizeof(Test_Disk_Reset_method)}, UINT32};

constinit Meta_Class Test_Thing::static_meta_class =
    make(0, "Test_Thing", disk_features.features, num_thing_properties, sizeof(Test_Thing), nullptr, 1);
constinit Meta_Class Test_Disk::static_meta_class =
    make(0, "Test_Disk", disk_features.features, num_disk_features, sizeof(Test_Disk), &Test_Thing::static_meta_class, 1);
constinit Meta_Class Test_Link::static_meta_class =
    make(Flag_Association, "Test_Link", link_features, std::size(link_features), sizeof(Test_Link), &relation, 2);
constinit Meta_Class Test_Alert::static_meta_class =
    make(Flag_Indication, "Test_Alert", alert_features, std::size(alert_features), sizeof(Test_Alert), nullptr, 0);
constinit Meta_Class Test_Odd::static_meta_class = make(0, "Test_Odd", odd_features, 1, sizeof(Test_Odd), nullptr, 0);

constinit const Meta_Repository repository = {classes, std::size(classes)};

Ref<Test_Thing> thing(const char* name)
{
    Ref<Test_Thing> result(create<Test_Thing>());
    result->Name.set(name);
    return result;
}

Ref<Test_Thing> full_thing(const char* name)
{
    Ref<Test_Thing> t = thing(name);
    t->Boolean.set(true);
    t->Uint8.set(0xFF);
    t->Sint8.set(-0x80);
    t->Uint16.set(0xFFFF);
    t->Sint16.set(-0x8000);
    t->Uint32.set(0xFFFFFFFF);
    t->Sint32.set(-0x7FFFFFFF - 1);
    t->Uint64.set(0xFFFFFFFFFFFFFFFF);
    t->Sint64.set(-0x7FFFFFFFFFFFFFFF - 1);
    t->Real32.set(0.1F);
    t->Real64.set(-1.5e300);
    t->Char16.set(char16(0x20AC));
    t->When.set(Datetime(90 * Datetime::MIN + 7));
    t->Booleans.set({true, false, true});
    t->Uint8s.set({0, 0xFF});
    t->Sint64s.set({-1});
    t->Char16s.set({char16('a'), char16(0xFFFF)});
    t->Strings.set({"", "one", "zw\xC3\xB6lf"});
    t->Whens.set({Datetime(), Datetime(Datetime::DAY)});
    return t;
}

Ref<Test_Link> make_link(const char* antecedent, const char* dependent)
{
    Ref<Test_Link> result(create<Test_Link>());
    result->Antecedent = thing(antecedent).steal();
    result->Dependent = thing(dependent).steal();
    return result;
}

unsigned live_instances()
{
    unsigned count = 0;
    for (const Meta_Class* meta_class : classes)
        count += Atomic_get(&meta_class->refs) - 1;
    return count;
}

} // namespace test
