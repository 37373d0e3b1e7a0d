#include "cli/json.h"

#include <nlohmann/json.hpp>

namespace hxa
{

namespace
{

using Json = nlohmann::ordered_json;

Json json_of(const Value& value);

struct To_Json
{
    Json operator()(const List& list) const
    {
        Json array = Json::array();
        for (const auto& element : list)
            array.push_back(json_of(element));
        return array;
    }
    Json operator()(const Object& members) const
    {
        Json object = Json::object();
        for (const auto& member : members)
            object[member.key] = json_of(member.value);
        return object;
    }
    template <typename Scalar> Json operator()(const Scalar& scalar) const { return scalar; }
};

Json json_of(const Value& value) { return std::visit(To_Json{}, value.data()); }

std::string text_of(const Value& value, int indentation)
{
    return json_of(value).dump(indentation, ' ', false, Json::error_handler_t::replace) + '\n';
}

} // namespace

std::string json_text(const Value& value) { return text_of(value, 2); }
std::string json_line(const Value& value) { return text_of(value, -1); }

} // namespace hxa
