// Which queries are served, what they let through, and why others are refused.
#include "cimserver/model/event_query.h"
#include "tests/support/rows.h"

#include <gtest/gtest.h>

using namespace cimserver;

namespace
{

Value array_of_texts() { return {static_cast<CMPIType>(CMPI_string | CMPI_ARRAY), std::vector<Value>()}; }

Instance alert()
{
    return {{"", "root/test", "TST_Alert", {}},
            {{"Text", {CMPI_string, std::string("it's \"hot\"")}},
             {"Number", {CMPI_sint64, std::int64_t{-5}}},
             {"Size", {CMPI_uint64, std::uint64_t{18446744073709551615U}}},
             {"Ratio", {CMPI_real64, 0.5}},
             {"Urgent", {CMPI_boolean, true}},
             {"Nothing", {CMPI_string, {}}},
             {"Time", {CMPI_dateTime, std::string("20260101000000.000000+000")}},
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

TEST(event_query, lets_through_what_meets_its_condition_and_refuses_what_it_cannot_keep)
{
    for (const auto& row : rows_of("indications/queries.txt"))
        if (row[0] == "refused")
            EXPECT_NE(refusal(row.at(1)).find(row.at(2)), std::string::npos) << row[1] << ": " << refusal(row[1]);
        else
            EXPECT_EQ(wanted(row.at(1)), row[0] == "wanted") << row[1];

    const std::string where = "SELECT * FROM TST_Alert WHERE ";
    const std::pair<std::string, const char*> rows[] = {{"", "expected SELECT"},
                                                        {where + repeat("(", 1000) + "Number = 1", "too deeply"},
                                                        {where + repeat("NOT ", 500) + "Number = 1", "too deeply"},
                                                        {where + repeat(" ", 5000), "longer than"}};
    for (const auto& [query, told] : rows)
        EXPECT_NE(refusal(query).find(told), std::string::npos) << query << ": " << refusal(query);
}
