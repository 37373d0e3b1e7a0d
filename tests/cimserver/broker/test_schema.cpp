#include "test_schema.h"

#include <iterator>

using namespace zmlr;

namespace
{

extern const Meta_Repository repository;

constexpr Meta_Property property(const char* name, Type type, sint16 subscript = 0, uint32 flags = Flag_Read)
{
    return {{{0}, Flag_Property | flags, name, nullptr, 0}, static_cast<uint16>(type), subscript, 0, nullptr};
}

constexpr Meta_Property key(const char* name, Type type) { return property(name, type, 0, Flag_Read | Flag_Key); }

constexpr Meta_Reference reference(const char* name, const Meta_Class* target, uint32 flags = 0)
{
    return {{{0}, Flag_Reference | flags, name, nullptr, 0}, 0, target, 0};
}

template <std::size_t N>
constexpr Meta_Class make_class(const char* name, uint32 flags, const Meta_Feature* const (&features)[N], const Meta_Class* super)
{
    return {{{{0}, flags, name, nullptr, 0}, features, N, 0}, nullptr, super, 0, &repository};
}

constexpr Meta_Class featureless_class(const char* name, uint32 flags, const Meta_Class* super)
{
    return {{{{0}, flags, name, nullptr, 0}, nullptr, 0, 0}, nullptr, super, 0, &repository};
}

constexpr Meta_Property id = key("Id", STRING);
constexpr Meta_Property name = property("Name", STRING);
constexpr Meta_Property return_value = property("return_value", UINT32, 0, Flag_Out);
constexpr const Meta_Feature* reset_features[] = {&return_value};
constexpr Meta_Method reset = {{{{0}, Flag_Method, "Reset", nullptr, 0}, reset_features, 1, 0}, UINT32};

constexpr Meta_Class top = featureless_class("TST_Top", Flag_Abstract, nullptr);

constexpr const Meta_Feature* base_features[] = {&id, &name, &reset};
constexpr Meta_Class base = make_class("TST_Base", Flag_Abstract, base_features, &top);

constexpr Meta_Property size = property("Uint8", UINT8);
constexpr Meta_Property numbers = property("Uint16s", UINT16, -1);
constexpr Meta_Property texts = property("Strings", STRING, -1);

constexpr const Meta_Feature* disk_features[] = {&id, &name, &reset, &size, &numbers, &texts};
constexpr Meta_Class disk = make_class("TST_Disk", 0, disk_features, &base);

constexpr Meta_Property speed = property("Speed", UINT32);
constexpr const Meta_Feature* tape_features[] = {&id, &name, &reset, &speed};
constexpr Meta_Class tape = make_class("TST_Tape", 0, tape_features, &base);

constexpr const Meta_Feature* broken_features[] = {&id};
constexpr Meta_Class broken = make_class("TST_Broken", Flag_Abstract, broken_features, &top);
constexpr Meta_Class failing = make_class("TST_Failing", 0, broken_features, &broken);
constexpr Meta_Class alert = featureless_class("TST_Alert", Flag_Indication, nullptr);
constexpr Meta_Class idle = featureless_class("TST_Idle", 0, nullptr);

constexpr Meta_Reference left = reference("Left", &base, Flag_Key);
constexpr Meta_Property link_keys[] = {
    key("Flag", BOOLEAN), key("Count", UINT8),  key("Offset", SINT8),
    key("Mark", CHAR16),  key("Ratio", REAL64), key("When", DATETIME),
};
constexpr const Meta_Feature* link_features[] = {
    &left, &link_keys[0], &link_keys[1], &link_keys[2], &link_keys[3], &link_keys[4], &link_keys[5], &name,
};
constexpr Meta_Class link = make_class("TST_Link", Flag_Association, link_features, nullptr);

constexpr const Meta_Class* classes[] = {&top, &base, &disk, &tape, &broken, &failing, &link, &alert, &idle};
constexpr Meta_Repository repository = {classes, std::size(classes)};

int no_operation(const Registration*, int, void*, void*, void*, void*, void*, void*, void*, void*) { return -1; }

constexpr Registration registration(const char* provider, const Meta_Class* meta_class, const Registration* next)
{
    return {"test_Module", provider, no_operation, meta_class, next};
}

constexpr Registration registered[5] = {
    registration("TST_Disk_Provider", &disk, nullptr),
    registration("TST_Tape_Provider", &tape, &registered[0]),
    registration("TST_Failing_Provider", &failing, &registered[1]),
    registration("TST_Link_Provider", &link, &registered[2]),
    registration("TST_Alert_Provider", &alert, &registered[3]),
};

} // namespace

const Registration* test_registrations() { return &registered[std::size(registered) - 1]; }
