#include "cli/value.h"

#include <algorithm>
#include <utility>

namespace hxa
{

Value::Value() = default;
Value::Value(bool data) : _data(data) {}
Value::Value(int data) : _data(std::int64_t{data}) {}
Value::Value(unsigned data) : _data(std::uint64_t{data}) {}
Value::Value(std::uint64_t data) : _data(data) {}
Value::Value(double data) : _data(data) {}
Value::Value(std::string data) : _data(std::move(data)) {}
Value::Value(const char* data) : _data(std::string(data)) {}
Value::Value(List data) : _data(std::move(data)) {}
Value::Value(Object data) : _data(std::move(data)) {}
Value::Value(const Value& other) = default;
Value::Value(Value&& other) noexcept = default;
Value& Value::operator=(const Value& other) = default;
Value& Value::operator=(Value&& other) noexcept = default;
Value::~Value() = default;

const List& Value::list() const
{
    static const List none;
    const auto* found = std::get_if<List>(&_data);
    return found ? *found : none;
}

const Value& Value::at(std::string_view path) const
{
    static const Value none;
    const auto key = path.substr(0, path.find('.'));
    const auto* object = std::get_if<Object>(&_data);
    if (!object)
        return none;
    const auto found = std::find_if(object->begin(), object->end(), [=](const Member& member) { return member.key == key; });
    if (found == object->end())
        return none;
    return key.size() == path.size() ? found->value : found->value.at(path.substr(key.size() + 1));
}

} // namespace hxa
