// The query of an indication filter, in WQL or DMTF:CQL (DSP0202): which indications a subscriber wants, and what of them.
//
//   SELECT * | property, ... FROM class [WHERE condition]
//
// A condition compares a property of the class with a literal (=, <>, !=, <, <=, >, >=; strings and booleans only with the first
// three), tests it (IS NULL, IS NOT NULL), or joins conditions (NOT, AND, OR, parentheses). Both languages agree on this. What
// goes beyond it (functions, paths into embedded objects, arrays, datetimes, LIKE, ISA, joins) is refused when the filter is
// made: a filter that silently delivers too much, or nothing, would be found out too late.
//
// As in SQL a comparison with a null is neither true nor false, and only what is true is wanted.
#pragma once

#include "cimserver/model/property_layout.h"
#include "cimserver/model/values.h"

#include <optional>
#include <string>
#include <vector>

namespace cimserver
{

inline constexpr std::size_t max_query_bytes = 4096;

// One node of a WHERE clause.
struct Query_Condition
{
    enum class Kind
    {
        compare,
        is_null,
        negation,
        conjunction,
        disjunction
    };
    enum class Relation : unsigned // what may come of a comparison that it allows, as bits
    {
        less = 1,
        equal = 2,
        greater = 4,
        unordered = 8, // a number that is none
        less_or_equal = less | equal,
        greater_or_equal = greater | equal,
        unequal = less | greater | unordered
    };

    Kind kind = Kind::compare;
    std::string property; // compare, is_null
    Relation relation = Relation::equal;
    std::variant<std::string, bool, long double> literal; // long double holds every 64-bit integer
    std::vector<Query_Condition> parts;                   // of a negation one, of the junctions two or more
};

// The parts of a query.
struct Parsed_Query
{
    std::string class_name;
    Property_List select; // absent: all
    std::optional<Query_Condition> where;
};

// Throws Cim_Error CIM_ERR_INVALID_QUERY that tells where the text cannot be read. Depth and length of a query are bounded.
Parsed_Query parse_query(const std::string& text);

class Event_Query
{
public:
    explicit Event_Query(const std::string& text) : _query(parse_query(text)) {}

    const std::string& class_name() const { return _query.class_name; }

    // Throws Cim_Error CIM_ERR_INVALID_QUERY when the class lacks a property that the query names, or the property's type does
    // not go with what it is compared with.
    void check(const Property_Layout& layout) const;

    bool wants(const Instance& indication) const;
    Instance selected(Instance indication) const; // with the properties that the query names

private:
    Parsed_Query _query;
};

} // namespace cimserver
