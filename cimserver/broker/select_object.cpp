#include "cimserver/broker/objects.h"

#include <regex>

namespace cimserver
{
namespace
{

// The list between SELECT and FROM. Its end is looked for in the head of the text only: the rest may be of any length.
std::vector<std::string> selected_properties(const std::string& query)
{
    constexpr std::size_t longest_head = 4096;
    static const std::regex select_from(R"(^\s*select\s+(\*|[\w.]+(?:\s*,\s*[\w.]+)*)\s+from\s+\w)", std::regex::icase);
    static const std::regex name(R"([\w.]+)");
    const std::string head = query.substr(0, longest_head);
    std::smatch match;
    if (!std::regex_search(head, match, select_from))
        throw Failure{CMPI_RC_ERR_INVALID_QUERY};
    const std::string list = match[1];
    return {std::sregex_token_iterator(list.begin(), list.end(), name), std::sregex_token_iterator()};
}

CMPIString* get_string(const CMPISelectExp* self, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr, [&] { return make<String_Object>(object<Select_Object>(self).query).face(); });
}

CMPIBoolean evaluate(const CMPISelectExp*, const CMPIInstance*, CMPIStatus* status) noexcept
{
    return not_supported<CMPIBoolean>(status, 0);
}

CMPISelectCond* no_condition(const CMPISelectExp*, CMPIStatus* status) noexcept
{
    return not_supported<CMPISelectCond*>(status, nullptr);
}

CMPIBoolean evaluate_using_accessor(const CMPISelectExp*, CMPIAccessor*, void*, CMPIStatus* status) noexcept
{
    return not_supported<CMPIBoolean>(status, 0);
}

} // namespace

Select_Object::Select_Object(std::string query_) : query(std::move(query_)), projection(selected_properties(query)) {}

const CMPISelectExpFT Select_Object::table = {
    .ftVersion = 100,
    .release = release<Select_Object>,
    .clone = clone<Select_Object>,
    .evaluate = evaluate,
    .getString = get_string,
    .getDOC = no_condition,
    .getCOD = no_condition,
    .evaluateUsingAccessor = evaluate_using_accessor,
};

} // namespace cimserver
