#include "cimserver/model/query_tokens.h"

#include "cimserver/model/values.h"

#include <string_view>

namespace cimserver
{
namespace
{

// ASCII only, whatever the locale.
bool is_digit(char c) { return c >= '0' && c <= '9'; }
bool starts_name(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_'; }
bool continues_name(char c) { return starts_name(c) || is_digit(c) || c == '.'; }
bool is_blank(char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\n'; }

class Scanner
{
public:
    explicit Scanner(const std::string& text) : _text(text) {}

    Query_Token next()
    {
        while (_at < _text.size() && is_blank(_text[_at]))
            ++_at;
        Query_Token token{Query_Token::Kind::end, "", _at};
        if (_at == _text.size())
            return token;
        const char c = _text[_at];
        if (starts_name(c))
            take_while(token, Query_Token::Kind::word, continues_name);
        else if (is_digit(c) || ((c == '-' || c == '+' || c == '.') && is_digit(peek(1))))
            take_number(token);
        else if (c == '\'' || c == '"')
            take_string(token);
        else
            take_sign(token);
        return token;
    }

private:
    char peek(std::size_t ahead) const { return _at + ahead < _text.size() ? _text[_at + ahead] : '\0'; }

    template <class Predicate> void take_while(Query_Token& token, Query_Token::Kind kind, Predicate predicate)
    {
        token.kind = kind;
        while (_at < _text.size() && predicate(_text[_at]))
            token.text.push_back(_text[_at++]);
    }

    void take_number(Query_Token& token)
    {
        token.text.push_back(_text[_at++]); // a sign, perhaps
        take_while(token, Query_Token::Kind::number, [](char c) { return is_digit(c) || c == '.'; });
        if (peek(0) != 'e' && peek(0) != 'E')
            return;
        token.text.push_back(_text[_at++]);
        if (peek(0) == '-' || peek(0) == '+')
            token.text.push_back(_text[_at++]);
        take_while(token, Query_Token::Kind::number, is_digit);
    }

    void take_string(Query_Token& token)
    {
        token.kind = Query_Token::Kind::string;
        const char quote = _text[_at++];
        for (; _at < _text.size(); ++_at)
        {
            if (_text[_at] == '\\' && _at + 1 < _text.size())
                ++_at;
            else if (_text[_at] == quote && peek(1) == quote)
                ++_at;
            else if (_text[_at] == quote)
            {
                ++_at;
                return;
            }
            token.text.push_back(_text[_at]);
        }
        refuse_query("a string has no end");
    }

    void take_sign(Query_Token& token)
    {
        token.kind = Query_Token::Kind::sign;
        for (const std::string_view sign : {"<>", "!=", "<=", ">=", "<", ">", "=", "(", ")", ",", "*"})
            if (_text.compare(_at, sign.size(), sign) == 0)
            {
                token.text = sign;
                _at += sign.size();
                return;
            }
        refuse_query("unexpected character at position " + std::to_string(_at + 1));
    }

    const std::string& _text;
    std::size_t _at = 0;
};

} // namespace

void refuse_query(const std::string& why) { throw Cim_Error(CIM_ERR_INVALID_QUERY, "the query cannot be served: " + why); }

std::vector<Query_Token> query_tokens(const std::string& text)
{
    Scanner scanner(text);
    std::vector<Query_Token> tokens;
    do
        tokens.push_back(scanner.next());
    while (tokens.back().kind != Query_Token::Kind::end);
    return tokens;
}

} // namespace cimserver
