// Reads the text of a query (event_query.h) into its parts.
#pragma once

#include "cimserver/model/event_query.h"

namespace cimserver
{

struct Parsed_Query
{
    std::string class_name;
    Property_List select; // absent: all
    std::optional<Query_Condition> where;
};

// Throws Cim_Error CIM_ERR_INVALID_QUERY. Depth and length of a query are bounded.
Parsed_Query parse_query(const std::string& text);

} // namespace cimserver
