// Reads the text of a query into its parts.
#include "cimserver/model/event_query.h"
#include "cimserver/model/names.h"
#include "cimserver/model/query_tokens.h"

#include <charconv>
#include <string_view>

namespace cimserver
{
namespace
{

using Kind = Query_Condition::Kind;
using Relation = Query_Condition::Relation;

constexpr int max_depth = 32; // of parentheses and NOT

struct Sign
{
    std::string_view text;
    Relation relation;
    Relation mirrored; // with the sides exchanged
};

// clang-format off
constexpr Sign signs[] = {
    {"=",  Relation::equal,            Relation::equal},
    {"<>", Relation::unequal,          Relation::unequal},
    {"!=", Relation::unequal,          Relation::unequal},
    {"<",  Relation::less,             Relation::greater},
    {"<=", Relation::less_or_equal,    Relation::greater_or_equal},
    {">",  Relation::greater,          Relation::less},
    {">=", Relation::greater_or_equal, Relation::less_or_equal},
};
// clang-format on

constexpr std::string_view keywords[] = {"SELECT", "FROM", "WHERE", "AND",   "OR",   "NOT",
                                         "IS",     "NULL", "TRUE",  "FALSE", "LIKE", "ISA"};

class Parser
{
public:
    explicit Parser(const std::string& text) : _tokens(query_tokens(text)) {}

    Parsed_Query parse()
    {
        Parsed_Query query;
        expect("SELECT");
        query.select = select_list();
        expect("FROM");
        query.class_name = name();
        if (accept("WHERE"))
            query.where = disjunction(0);
        if (now().kind != Query_Token::Kind::end)
            unexpected();
        strip_class(query);
        return query;
    }

private:
    const Query_Token& now() const { return _tokens[_at]; }
    bool at_literal() const
    {
        return now().kind == Query_Token::Kind::number || now().kind == Query_Token::Kind::string || is("TRUE") || is("FALSE");
    }
    bool is(std::string_view word) const
    {
        const bool plain = now().kind == Query_Token::Kind::word || now().kind == Query_Token::Kind::sign;
        return plain && equal_names(now().text, word);
    }

    bool accept(std::string_view word)
    {
        if (!is(word))
            return false;
        ++_at;
        return true;
    }

    void expect(std::string_view word)
    {
        if (!accept(word))
            refuse_query("expected " + std::string(word) + " at position " + std::to_string(now().position + 1));
    }

    [[noreturn]] void unexpected() const
    {
        if (now().kind == Query_Token::Kind::end)
            refuse_query("it ends too early");
        refuse_query("unexpected \"" + now().text + "\" at position " + std::to_string(now().position + 1));
    }

    std::string name()
    {
        if (now().kind != Query_Token::Kind::word || is_among(keywords, now().text))
            unexpected();
        return _tokens[_at++].text;
    }

    Property_List select_list()
    {
        if (accept("*"))
            return std::nullopt;
        std::vector<std::string> names{name()};
        while (accept(","))
            names.push_back(name());
        return names;
    }

    template <class Part> Query_Condition join(Kind kind, std::string_view word, Part part)
    {
        Query_Condition first = part();
        if (!is(word))
            return first;
        Query_Condition joined{kind, "", {}, {}, {}};
        joined.parts.push_back(std::move(first));
        while (accept(word))
            joined.parts.push_back(part());
        return joined;
    }

    Query_Condition disjunction(int depth)
    {
        return join(Kind::disjunction, "OR", [&] { return join(Kind::conjunction, "AND", [&] { return single(depth); }); });
    }

    Query_Condition single(int depth)
    {
        if (depth > max_depth)
            refuse_query("it is nested too deeply");
        if (accept("NOT"))
            return negation(single(depth + 1));
        if (!accept("("))
            return comparison();
        Query_Condition inner = disjunction(depth + 1);
        expect(")");
        return inner;
    }

    static Query_Condition negation(Query_Condition inner)
    {
        Query_Condition outer{Kind::negation, "", {}, {}, {}};
        outer.parts.push_back(std::move(inner));
        return outer;
    }

    Query_Condition comparison()
    {
        Query_Condition condition;
        if (at_literal())
        {
            condition.literal = literal();
            condition.relation = relation().mirrored;
            condition.property = name();
            return condition;
        }
        condition.property = name();
        if (accept("IS"))
            return null_test(std::move(condition));
        condition.relation = relation().relation;
        condition.literal = literal();
        return condition;
    }

    Query_Condition null_test(Query_Condition condition)
    {
        condition.kind = Kind::is_null;
        const bool negated = accept("NOT");
        expect("NULL");
        return negated ? negation(std::move(condition)) : condition;
    }

    const Sign& relation()
    {
        for (const Sign& sign : signs)
            if (now().kind == Query_Token::Kind::sign && accept(sign.text))
                return sign;
        unexpected();
    }

    std::variant<std::string, bool, long double> literal()
    {
        if (!at_literal())
            unexpected();
        const Query_Token& token = _tokens[_at++];
        if (token.kind == Query_Token::Kind::string)
            return token.text;
        if (token.kind == Query_Token::Kind::word)
            return equal_names(token.text, "TRUE");
        return number(token);
    }

    static long double number(const Query_Token& token)
    {
        const std::string_view text = std::string_view(token.text).substr(token.text.starts_with('+') ? 1 : 0);
        long double value = 0;
        const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
        if (result.ec != std::errc() || result.ptr != text.data() + text.size())
            refuse_query(token.text + " is no number");
        return value;
    }

    // CQL names a property with its class too: "Class.Property".
    static void strip(std::string& property, const std::string& class_name)
    {
        const std::size_t dot = property.find('.');
        if (dot == std::string::npos)
            return;
        if (!equal_names(property.substr(0, dot), class_name) || property.find('.', dot + 1) != std::string::npos)
            refuse_query(property + " is no property of the class");
        property.erase(0, dot + 1);
    }

    static void strip(Query_Condition& condition, const std::string& class_name)
    {
        strip(condition.property, class_name);
        for (Query_Condition& part : condition.parts)
            strip(part, class_name);
    }

    static void strip_class(Parsed_Query& query)
    {
        if (query.select)
            for (std::string& property : *query.select)
                strip(property, query.class_name);
        if (query.where)
            strip(*query.where, query.class_name);
    }

    std::vector<Query_Token> _tokens;
    std::size_t _at = 0;
};

} // namespace

Parsed_Query parse_query(const std::string& text)
{
    if (text.size() > max_query_bytes)
        refuse_query("it is longer than " + std::to_string(max_query_bytes) + " bytes");
    return Parser(text).parse();
}

} // namespace cimserver
