// The qualifiers that clients ask for and the module does not carry: Description, ValueMap, Values, and the class that
// EmbeddedInstance names.
//
// Generated from the MOF. Rows are sorted by class, feature and parameter name (ASCII, lower case); an inherited feature's row
// stands at the class that declares it.
#pragma once

namespace cimserver
{

struct Qualifier_Row
{
    const char* class_name;
    const char* feature_name;   // "" for the class itself
    const char* parameter_name; // of a method; "" for the feature itself
    const char* name;           // "Description", "EmbeddedInstance", "ValueMap", "Values"
    bool array;
    const char* const* values; // string values; one unless array
    unsigned num_values;
};

extern const Qualifier_Row qualifier_table[];
extern const unsigned qualifier_table_size;

// What clients can ask of a qualifier itself (DSP0004). Rows are sorted by name.
struct Qualifier_Declaration
{
    const char* name;
    const char* type;
    const char* value; // unless said otherwise; null: none
    bool array;
    bool overridable;
    bool to_subclass;
    bool translatable;
    const char* scopes; // names of the meta elements that can have it, separated by blanks
    unsigned flag;      // of the meta-data that stands for "true"; 0 when it is not written from one
};

extern const Qualifier_Declaration qualifier_declarations[];
extern const unsigned num_qualifier_declarations;

} // namespace cimserver
