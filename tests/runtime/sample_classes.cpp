#include "tests/runtime/sample_classes.h"

#include <cstddef>

// Records are laid out by the compiler and located by offset, as generated ones are.
#pragma GCC diagnostic ignored "-Winvalid-offsetof"

namespace sample
{

namespace
{

constexpr uint32 key = Flag_Property | Flag_Key | Flag_Read;
constexpr uint32 plain = Flag_Property | Flag_Read;
constexpr uint32 key_reference = Flag_Reference | Flag_Key;

constexpr Meta_Property make(uint32 flags, const char* name, Type type, bool array, std::size_t offset,
                             const Meta_Value* value = nullptr)
{
    return {{{0}, flags, name, nullptr, 0},
            static_cast<uint16>(type),
            static_cast<sint16>(array ? -1 : 0),
            static_cast<uint32>(offset),
            value};
}

constexpr Meta_Reference make(uint32 flags, const char* name, bool array, const Meta_Class* meta_class, std::size_t offset)
{
    return {{{0}, flags, name, nullptr, 0}, static_cast<uint16>(array), meta_class, static_cast<uint32>(offset)};
}

// The local marks are left out: only a server reads them.
template <class T>
constexpr Meta_Class make(uint32 flags, const char* name, const Meta_Feature* const* features, uint32 count, uint32 num_keys,
                          const Meta_Class* super = nullptr)
{
    return {{{{0}, flags, name, nullptr, 0}, features, count, sizeof(T)}, nullptr, super, num_keys, &repository};
}

constexpr uint32 one = 1;
constexpr char16 letter(u'x');
constexpr uint16 codes[] = {2, 3, 5};
constexpr const char* labels[] = {"a", "b"};
constexpr const char* intervals[] = {"00000000000000.000000:000"};

constexpr Meta_Value default_size = {&one, 1};
constexpr Meta_Value default_letter = {&letter, 1};
constexpr Meta_Value default_since = {"00000001000000.000000:000", 1};
constexpr Meta_Value default_caption = {"new element", 1};
constexpr Meta_Value default_labels = {labels, 2};
constexpr Meta_Value default_codes = {codes, 3};
constexpr Meta_Value default_intervals = {intervals, 1};

// clang-format off
constexpr Meta_Property element_name      = make(key,   "Name",      STRING,   false, offsetof(Sample_Element, Name));
constexpr Meta_Property element_online    = make(plain, "Online",    BOOLEAN,  false, offsetof(Sample_Element, Online));
constexpr Meta_Property element_slot      = make(plain, "Slot",      UINT8,    false, offsetof(Sample_Element, Slot));
constexpr Meta_Property element_size      = make(plain, "Size",      UINT32,   false, offsetof(Sample_Element, Size), &default_size);
constexpr Meta_Property element_delta     = make(plain, "Delta",     SINT64,   false, offsetof(Sample_Element, Delta));
constexpr Meta_Property element_load      = make(plain, "Load",      REAL64,   false, offsetof(Sample_Element, Load));
constexpr Meta_Property element_letter    = make(plain, "Letter",    CHAR16,   false, offsetof(Sample_Element, Letter), &default_letter);
constexpr Meta_Property element_since     = make(plain, "Since",     DATETIME, false, offsetof(Sample_Element, Since), &default_since);
constexpr Meta_Property element_caption   = make(plain, "Caption",   STRING,   false, offsetof(Sample_Element, Caption), &default_caption);
constexpr Meta_Property element_labels    = make(plain, "Labels",    STRING,   true,  offsetof(Sample_Element, Labels), &default_labels);
constexpr Meta_Property element_codes     = make(plain, "Codes",     UINT16,   true,  offsetof(Sample_Element, Codes), &default_codes);
constexpr Meta_Property element_intervals = make(plain, "Intervals", DATETIME, true,  offsetof(Sample_Element, Intervals), &default_intervals);
constexpr Meta_Property element_samples   = make(plain, "Samples",   REAL64,   true,  offsetof(Sample_Element, Samples));
constexpr Meta_Property disk_blocks       = make(plain, "Blocks",    UINT64,   false, offsetof(Sample_Disk, Blocks));
constexpr Meta_Property person_name       = make(key,   "Name",      STRING,   false, offsetof(Sample_Person, Name));
constexpr Meta_Property setting_level     = make(plain, "Level",     UINT32,   false, offsetof(Sample_Setting, Level));
constexpr Meta_Property link_note         = make(plain, "Note",      STRING,   false, offsetof(Sample_Link, Note));
constexpr Meta_Reference link_antecedent  = make(key_reference,  "Antecedent", false, &Sample_Element::static_meta_class, offsetof(Sample_Link, Antecedent));
constexpr Meta_Reference link_dependent   = make(key_reference,  "Dependent",  false, &Sample_Disk::static_meta_class, offsetof(Sample_Link, Dependent));
constexpr Meta_Reference link_others      = make(Flag_Reference, "Others",     true,  &Sample_Element::static_meta_class, offsetof(Sample_Link, Others));

constexpr Meta_Property  reset_delay  = make(Flag_Property | Flag_In,  "Delay", UINT32, false, offsetof(Sample_Element_Reset_method, Delay));
constexpr Meta_Reference reset_peer   = make(Flag_Reference | Flag_In, "Peer", false, &Sample_Element::static_meta_class, offsetof(Sample_Element_Reset_method, Peer));
constexpr Meta_Property  reset_return = make(Flag_Property | Flag_Out, "return_value", UINT32, false, offsetof(Sample_Element_Reset_method, return_value));
// clang-format on

// clang-format off
constexpr const Meta_Feature* reset_features[] = {&reset_delay, &reset_peer, &reset_return};
constexpr const Meta_Feature* disk_features[] = { // those of an element, then its own
    &element_name, &element_online, &element_slot, &element_size, &element_delta, &element_load, &element_letter, &element_since,
    &element_caption, &element_labels, &element_codes, &element_intervals, &element_samples,
    &Sample_Element_Reset_method::static_meta_class, &disk_blocks};
// clang-format on
constexpr const Meta_Feature* link_features[] = {&link_antecedent, &link_dependent, &link_others, &link_note};
constexpr const Meta_Feature* person_features[] = {&person_name};
constexpr const Meta_Feature* setting_features[] = {&setting_level};

constexpr const Meta_Class* classes[] = {&Sample_Element::static_meta_class, &Sample_Disk::static_meta_class,
                                         &Sample_Link::static_meta_class, &Sample_Person::static_meta_class,
                                         &Sample_Setting::static_meta_class};

} // namespace

constinit const Meta_Method Sample_Element_Reset_method::static_meta_class = {
    {{{0}, Flag_Method, "Reset", nullptr, 0}, reset_features, 3, sizeof(Sample_Element_Reset_method)}, UINT32};

constinit const Meta_Class Sample_Element::static_meta_class =
    make<Sample_Element>(Flag_Class, "Sample_Element", disk_features, 14, 1);
constinit const Meta_Class Sample_Disk::static_meta_class =
    make<Sample_Disk>(Flag_Class, "Sample_Disk", disk_features, 15, 1, &Sample_Element::static_meta_class);
constinit const Meta_Class Sample_Link::static_meta_class =
    make<Sample_Link>(Flag_Association, "Sample_Link", link_features, 4, 2);
constinit const Meta_Class Sample_Person::static_meta_class =
    make<Sample_Person>(Flag_Class, "Sample_Person", person_features, 1, 1);
constinit const Meta_Class Sample_Setting::static_meta_class =
    make<Sample_Setting>(Flag_Class, "Sample_Setting", setting_features, 1, 0);

constinit const Meta_Repository repository = {classes, 5};

template <class T> Ref<T> named(const char* name)
{
    Ref<T> result(create<T>());
    result->Name.set(name);
    return result;
}

Ref<Sample_Element> element(const char* name) { return named<Sample_Element>(name); }
Ref<Sample_Disk> disk(const char* name) { return named<Sample_Disk>(name); }

Ref<Sample_Link> linked(Ref<Sample_Element> antecedent, Ref<Sample_Disk> dependent)
{
    Ref<Sample_Link> result(create<Sample_Link>());
    result->Antecedent = antecedent.steal();
    result->Dependent = dependent.steal();
    return result;
}

} // namespace sample
