// What a command found out, as a tree: the same tree is printed as JSON and, through columns (report.h), as text.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace hxa
{

class Value;
struct Member;

using List = std::vector<Value>;
using Object = std::vector<Member>; // in the order in which it is printed

class Value
{
public:
    using Data = std::variant<std::nullptr_t, bool, std::int64_t, std::uint64_t, double, std::string, List, Object>;

    Value(); // null: nothing is known
    Value(bool data);
    Value(int data);
    Value(unsigned data);
    Value(std::uint64_t data);
    Value(double data);
    Value(std::string data);
    Value(const char* data);
    Value(List data);
    Value(Object data);

    // Defined elsewhere: inline they would be in every place that builds a tree.
    Value(const Value& other);
    Value(Value&& other) noexcept;
    Value& operator=(const Value& other);
    Value& operator=(Value&& other) noexcept;
    ~Value();

    const Data& data() const { return _data; }
    bool is_null() const { return _data.index() == 0; }

    // The list, or the member of an object that a path like "fc.state" names; an empty one when there is none.
    const List& list() const;
    const Value& at(std::string_view path) const;

private:
    Data _data;
};

struct Member
{
    std::string key;
    Value value;
};

} // namespace hxa
