#include "cli/value.h"

#include <algorithm>

namespace hxa
{

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
