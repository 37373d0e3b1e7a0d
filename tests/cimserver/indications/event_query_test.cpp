// Which queries are served, what they let through, and why others are refused.
#include "cimserver/model/event_query.h"

#include <gtest/gtest.h>

using namespace cimserver;

namespace
{

Value array_of_texts() { return {static_cast<CMPIType>(CMPI_string | CMPI_ARRAY), std::vector<Value>()}; }

Instance alert()
{
    return {{"", "root/test", "TST_Alert", {}},
            {{"Text", {CMPI_string, "it's \"hot\""}},
             {"Number", {CMPI_sint64, std::int64_t{-5}}},
             {"Size", {CMPI_uint64, std::uint64_t{18446744073709551615U}}},
             {"Ratio", {CMPI_real64, 0.5}},
             {"Urgent", {CMPI_boolean, true}},
             {"Nothing", {CMPI_string, {}}},
             {"Time", {CMPI_dateTime, "20260101000000.000000+000"}},
             {"Texts", array_of_texts()}}};
}

bool wanted(const std::string& where)
{
    const Event_Query query("SELECT * FROM TST_Alert WHERE " + where);
    query.check(Property_Layout(alert()));
    return query.wants(alert());
}

// The description of the refusal; empty when the query is served.
std::string refusal(const std::string& text)
{
    try
    {
        Event_Query(text).check(Property_Layout(alert()));
        return "";
    }
    catch (const Cim_Error& error)
    {
        EXPECT_EQ(error.code(), CIM_ERR_INVALID_QUERY);
        return error.description();
    }
}

std::string repeat(const std::string& text, int times)
{
    std::string all;
    while (times-- > 0)
        all += text;
    return all;
}

} // namespace

TEST(event_query, lets_through_what_meets_its_condition)
{
    struct Row
    {
        const char* where;
        bool wanted;
    };
    const Row rows[] = {
        {"Text = 'it''s \"hot\"'", true},
        {"text = \"it's \\\"hot\\\"\"", true},
        {"Text <> ' FROM TST_Other WHERE '", true}, // in a literal these are no clauses
        {"Text = 'IT''S \"HOT\"'", false},
        {"Number = -5", true},
        {"Number < -4 AND Number > -6", true},
        {"Number <= -6", false},
        {"-5 >= Number", true},
        {"-6 > Number", false},
        {"Size = 18446744073709551615", true},
        {"Size > 18446744073709551614", true},
        {"Size <> 18446744073709551614", true},
        {"Ratio = 5e-1", true},
        {"Ratio != .5", false},
        {"Urgent = true", true},
        {"Urgent <> TRUE", false},
        {"TST_Alert.Urgent = TRUE", true},
        {"NOT Urgent = FALSE", true},
        {"Number = 1 OR Number = 2 OR Number = -5", true},
        {"Number = -5 OR Number = 1 AND Urgent = FALSE", true},
        {"(Number = -5 OR Number = 1) AND Urgent = FALSE", false},
        {"Nothing IS NULL", true},
        {"Text IS NOT NULL", true},
        {"Nothing = 'x'", false},
        {"NOT Nothing = 'x'", false}, // neither true nor false
        {"Nothing <> 'x' OR Urgent = TRUE", true},
        {"NOT (Nothing = 'x' AND Urgent = FALSE)", true},
        {"Texts IS NULL", false},
    };
    for (const Row& row : rows)
        EXPECT_EQ(wanted(row.where), row.wanted) << row.where;
}

TEST(event_query, refuses_what_it_cannot_keep)
{
    const std::string from = "SELECT * FROM TST_Alert";
    const std::pair<std::string, const char*> rows[] = {
        {"", "expected SELECT"},
        {"SELECT", "ends too early"},
        {"SELECT * FROM", "ends too early"},
        {"SELECT FROM TST_Alert", "\"FROM\""},
        {"SELECT * FROM WHERE Text = 'x'", "\"WHERE\""},
        {"SELECT COUNT(*) FROM TST_Alert", "expected FROM at position 13"},
        {"SELECT * FROM TST_Alert, TST_Other", "\",\""},
        {"SELECT Colour FROM TST_Alert", "no property Colour"},
        {from + " WHERE", "ends too early"},
        {from + " WHERE Colour = 'x'", "no property Colour"},
        {from + " WHERE Colour IS NULL", "no property Colour"},
        {from + " WHERE Text", "ends too early"},
        {from + " WHERE Text LIKE 'x%'", "\"LIKE\""},
        {from + " WHERE Text = Number", "\"Number\""},
        {from + " WHERE Text = 5", "Text"},
        {from + " WHERE Text < 'x'", "Text"},
        {from + " WHERE Number = 'x'", "Number"},
        {from + " WHERE Urgent > TRUE", "Urgent"},
        {from + " WHERE Time = '20260101000000.000000+000'", "Time"},
        {from + " WHERE Texts = 'x'", "Texts"},
        {from + " WHERE Other.Text = 'x'", "Other.Text"},
        {from + " WHERE TST_Alert.Text.Length = 5", "TST_Alert.Text.Length"},
        {from + " WHERE Text = 'x", "no end"},
        {from + " WHERE Number = 1.2.3", "1.2.3"},
        {from + " WHERE Number = 1e99999", "1e99999"},
        {from + " WHERE (Number = 1", "expected )"},
        {from + " WHERE Number = 1)", "\")\""},
        {from + " WHERE Number = 1 Urgent = TRUE", "\"Urgent\""},
        {from + " WHERE Number ; 1", "position 38"},
        {from + " WHERE " + repeat("(", 1000) + "Number = 1", "too deeply"},
        {from + " WHERE " + repeat("NOT ", 500) + "Number = 1", "too deeply"},
        {from + repeat(" ", 5000), "longer than"},
    };
    for (const auto& [query, told] : rows)
        EXPECT_NE(refusal(query).find(told), std::string::npos) << query << ": " << refusal(query);
}
