#include "cimserver/model/event_query.h"

#include "cimserver/model/names.h"
#include "cimserver/model/query_tokens.h"

namespace cimserver
{
namespace
{

using Kind = Query_Condition::Kind;
using Relation = Query_Condition::Relation;

bool is_number(CMPIType type) { return (type & (CMPI_INTEGER | CMPI_REAL)) != 0; }

std::optional<long double> number_of(const Value& value)
{
    if (const auto* number = value.as<std::uint64_t>())
        return *number;
    if (const auto* number = value.as<std::int64_t>())
        return *number;
    if (const auto* number = value.as<double>())
        return *number;
    return std::nullopt;
}

template <class T> bool holds(const T& left, Relation relation, const T& right)
{
    const Relation outcome = left < right    ? Relation::less
                             : left > right  ? Relation::greater
                             : left == right ? Relation::equal
                                             : Relation::unordered;
    return (static_cast<unsigned>(relation) & static_cast<unsigned>(outcome)) != 0;
}

// Absent: unknown, because the property is null.
std::optional<bool> compare(const Query_Condition& condition, const Value& value)
{
    if (const auto* text = std::get_if<std::string>(&condition.literal))
        if (const auto* mine = value.as<Text>())
            return holds(mine->view(), condition.relation, std::string_view(*text));
    if (const auto* flag = std::get_if<bool>(&condition.literal))
        if (const auto* mine = value.as<bool>())
            return holds(*mine, condition.relation, *flag);
    if (const auto* number = std::get_if<long double>(&condition.literal))
        if (const auto mine = number_of(value))
            return holds(*mine, condition.relation, *number);
    return std::nullopt;
}

std::optional<bool> evaluate(const Query_Condition& condition, const Instance& indication);

// A part that equals `decisive` decides; else one that is unknown makes the whole unknown.
std::optional<bool> join(const std::vector<Query_Condition>& parts, bool decisive, const Instance& indication)
{
    std::optional<bool> result = !decisive;
    for (const Query_Condition& part : parts)
    {
        const auto outcome = evaluate(part, indication);
        if (outcome == decisive)
            return decisive;
        if (!outcome)
            result.reset();
    }
    return result;
}

std::optional<bool> evaluate(const Query_Condition& condition, const Instance& indication)
{
    switch (condition.kind)
    {
    case Kind::negation:
    {
        const auto outcome = evaluate(condition.parts.front(), indication);
        return outcome ? std::optional(!*outcome) : std::nullopt;
    }
    case Kind::conjunction:
        return join(condition.parts, false, indication);
    case Kind::disjunction:
        return join(condition.parts, true, indication);
    case Kind::is_null:
    case Kind::compare:
        break;
    }
    const Value* property = indication.properties.find(condition.property);
    const Value value = property ? *property : Value();
    return condition.kind == Kind::is_null ? std::optional(value.null()) : compare(condition, value);
}

// Refuses a property that the class lacks.
CMPIType type_of(const std::string& name, const Property_Layout& layout, const std::string& class_name)
{
    const auto place = layout.find(name);
    if (!place)
        refuse_query("class " + class_name + " has no property " + name);
    return layout[*place].value.type;
}

void check_type(const Query_Condition& condition, CMPIType type)
{
    const bool ordered = condition.relation != Relation::equal && condition.relation != Relation::unequal;
    const bool fits = std::holds_alternative<std::string>(condition.literal) ? type == CMPI_string && !ordered
                      : std::holds_alternative<bool>(condition.literal)      ? type == CMPI_boolean && !ordered
                                                                             : (type & CMPI_ARRAY) == 0 && is_number(type);
    if (!fits)
        refuse_query("property " + condition.property + " cannot be compared like this");
}

void check_condition(const Query_Condition& condition, const Property_Layout& layout, const std::string& class_name)
{
    for (const Query_Condition& part : condition.parts)
        check_condition(part, layout, class_name);
    if (condition.kind != Kind::compare && condition.kind != Kind::is_null)
        return;
    const CMPIType type = type_of(condition.property, layout, class_name);
    if (condition.kind == Kind::compare)
        check_type(condition, type);
}

} // namespace

void Event_Query::check(const Property_Layout& layout) const
{
    if (_query.select)
        for (const std::string& name : *_query.select)
            type_of(name, layout, _query.class_name);
    if (_query.where)
        check_condition(*_query.where, layout, _query.class_name);
}

bool Event_Query::wants(const Instance& indication) const
{
    return !_query.where || evaluate(*_query.where, indication).value_or(false);
}

Instance Event_Query::selected(Instance indication) const
{
    if (!_query.select)
        return indication;
    std::vector<Named_Value> selected = indication.properties;
    std::erase_if(selected, [&](const Named_Value& property) { return !is_among(*_query.select, property.name); });
    indication.properties = std::move(selected);
    return indication;
}

} // namespace cimserver
