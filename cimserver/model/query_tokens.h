// Splits the text of a query into words, literals and signs.
#pragma once

#include <string>
#include <vector>

namespace cimserver
{

struct Query_Token
{
    enum class Kind
    {
        word, // a keyword or a name, perhaps with dots
        number,
        string,
        sign,
        end
    };

    Kind kind = Kind::end;
    std::string text; // of a string its content
    std::size_t position = 0;
};

// The tokens, the last one of kind end. Strings stand in single or double quotes; a backslash takes the next character as it
// is, a doubled quote stands for one. Throws Cim_Error CIM_ERR_INVALID_QUERY for what is none of these.
std::vector<Query_Token> query_tokens(const std::string& text);

[[noreturn]] void refuse_query(const std::string& why);

} // namespace cimserver
