#include "cimserver/broker/objects.h"

#include <cctype>
#include <string_view>
#include <strings.h>

namespace cimserver
{
namespace
{

// Takes a query apart from its front.
class Query_Head
{
public:
    explicit Query_Head(std::string_view text) : _text(text) {}

    // The word that stands next, blanks before it skipped; empty when something else does.
    std::string word()
    {
        skip([](unsigned char c) { return std::isspace(c) != 0; });
        return skip([](unsigned char c) { return std::isalnum(c) != 0 || c == '_' || c == '.'; });
    }

    // Whether this character stands next; then it is taken.
    bool takes(char wanted)
    {
        skip([](unsigned char c) { return std::isspace(c) != 0; });
        const bool found = _text.starts_with(wanted);
        _text.remove_prefix(found);
        return found;
    }

    bool takes_keyword(const char* keyword) { return strcasecmp(word().c_str(), keyword) == 0; }

private:
    template <typename Is> std::string skip(Is is)
    {
        std::size_t size = 0;
        while (size < _text.size() && is(static_cast<unsigned char>(_text[size])))
            ++size;
        std::string skipped(_text.substr(0, size));
        _text.remove_prefix(size);
        return skipped;
    }

    std::string_view _text;
};

// The list between SELECT and FROM; empty for all. It has to end in the head of the text, whose rest may be of any length.
std::vector<std::string> selected_properties(std::string_view query)
{
    constexpr std::size_t longest_head = 4096;
    Query_Head head(query.substr(0, longest_head));
    const auto expect = [](bool found)
    {
        if (!found)
            throw Failure{CMPI_RC_ERR_INVALID_QUERY};
    };
    std::vector<std::string> names;
    expect(head.takes_keyword("select"));
    if (!head.takes('*'))
        do
        {
            names.push_back(head.word());
            expect(!names.back().empty());
        } while (head.takes(','));
    expect(head.takes_keyword("from"));
    expect(!head.word().empty());
    return names;
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
