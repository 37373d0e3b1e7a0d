#include "test_classes.h"

#include "cimserver/qualifier_table.h"
#include "runtime/types.h"

#include <iterator>

namespace test
{

namespace
{

using namespace zmlr;

constexpr Meta_Feature head(uint32 flags, const char* name) { return {{0}, flags, name, nullptr, 0}; }

constexpr Meta_Property property(uint32 flags, const char* name, Type type, sint16 subscript = 0,
                                 const Meta_Value* value = nullptr)
{
    return {head(Flag_Property | flags, name), static_cast<uint16>(type), subscript, 0, value};
}

constexpr Meta_Reference reference(uint32 flags, const char* name, const Meta_Class* target, uint16 subscript = 0)
{
    return {head(Flag_Reference | flags, name), subscript, target, 0};
}

constexpr Meta_Class make_class(uint32 flags, const char* name, const Meta_Feature* const* features, uint32 count,
                                const Meta_Feature_Local* locals, const Meta_Class* super, uint32 keys)
{
    return {{head(flags, name), features, count, 0}, locals, super, keys, nullptr};
}

constexpr uint64 one = 1;
constexpr uint16 modes[] = {2, 65535};
constexpr Meta_Value speed_default{&one, 1};
constexpr Meta_Value modes_default{modes, 2};
constexpr Meta_Value status_default{"O<K", 1};

constexpr Meta_Property element_name = property(Flag_Key | Flag_Read, "Name", STRING);
constexpr Meta_Property element_status = property(Flag_Read, "Status", STRING, 0, &status_default);
constexpr Meta_Property port_name = property(Flag_Key | Flag_Read | Flag_Required, "Name", STRING);
constexpr Meta_Property port_speed = property(Flag_Counter, "Speed", UINT64, 0, &speed_default);
constexpr Meta_Property port_setting = property(Flag_EmbeddedInstance | Flag_Read, "Setting", STRING);
constexpr Meta_Property port_modes = property(Flag_Read | Flag_Write, "Modes", UINT16, 4, &modes_default);

constexpr Meta_Property reset_force = property(Flag_In, "Force", BOOLEAN);
constexpr Meta_Reference reset_job = reference(Flag_Out, "Job", &TST_Element);
constexpr Meta_Property reset_codes = property(Flag_In | Flag_Out, "Codes", UINT8, -1);
constexpr Meta_Property reset_return = property(Flag_Out, "return_value", UINT32);
constexpr const Meta_Feature* reset_parameters[] = {&reset_force, &reset_job, &reset_codes, &reset_return};
constexpr Meta_Method port_reset{{head(Flag_Method, "Reset"), reset_parameters, 4, 0}, UINT32};

constexpr const Meta_Feature* element_features[] = {&element_name, &element_status};
constexpr Meta_Feature_Local element_locals[] = {{1}, {1}};

// The method stands between the properties, as declaration order may have it.
constexpr const Meta_Feature* port_features[] = {&port_name,  &element_status, &port_speed,
                                                 &port_reset, &port_modes,     &port_setting};
constexpr Meta_Feature_Local port_locals[] = {{1}, {0}, {1}, {1}, {1}, {1}};

constexpr Meta_Reference link_antecedent = reference(Flag_Key, "Antecedent", &TST_Element);
constexpr Meta_Reference link_dependent = reference(Flag_Key | Flag_Weak, "Dependent", &TST_Port);
constexpr const Meta_Feature* link_features[] = {&link_antecedent, &link_dependent};
constexpr Meta_Feature_Local link_locals[] = {{1}, {1}};

} // namespace

constinit const Meta_Class TST_Element =
    make_class(Flag_Abstract, "TST_Element", element_features, 2, element_locals, nullptr, 1);
constinit const Meta_Class TST_Port = make_class(0, "TST_Port", port_features, 6, port_locals, &TST_Element, 1);
constinit const Meta_Class TST_Link = make_class(Flag_Association, "TST_Link", link_features, 2, link_locals, nullptr, 2);

} // namespace test

namespace cimserver
{

namespace
{

const char* const element_text[] = {"An element."};
const char* const port_text[] = {"A port."};
const char* const setting_class[] = {"TST_Element"};
const char* const status_text[] = {"How it is."};
const char* const name_text[] = {"The port's WWN."};
const char* const force_text[] = {"Even now."};
const char* const modes_map[] = {"2", ".."};
const char* const modes_values[] = {"Point & point", "Reserved"};

} // namespace

const Qualifier_Row qualifier_table[] = {
    {"TST_Element", "", "", "Description", false, element_text, 1},
    {"TST_Element", "Name", "", "Description", false, status_text, 1},
    {"TST_Element", "Status", "", "Description", false, status_text, 1},
    {"TST_Port", "", "", "Description", false, port_text, 1},
    {"TST_Port", "Modes", "", "ValueMap", true, modes_map, 2},
    {"TST_Port", "Modes", "", "Values", true, modes_values, 2},
    {"TST_Port", "Name", "", "Description", false, name_text, 1},
    {"TST_Port", "Reset", "Force", "Description", false, force_text, 1},
    {"TST_Port", "Setting", "", "EmbeddedInstance", false, setting_class, 1},
};
const unsigned qualifier_table_size = std::size(qualifier_table);

} // namespace cimserver
