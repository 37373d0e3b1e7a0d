#include "cimserver/model/paths.h"

#include "cimserver/model/names.h"

#include <algorithm>

namespace cimserver
{
namespace
{

std::string quoted(const std::string& text)
{
    std::string result = "\"";
    for (const char c : text)
    {
        if (c == '"' || c == '\\')
            result += '\\';
        result += c;
    }
    return result + '"';
}

std::string key_text(const Value& value)
{
    if (const auto* flag = value.as<bool>())
        return *flag ? "TRUE" : "FALSE";
    if (const auto* number = value.as<std::uint64_t>())
        return std::to_string(*number);
    if (const auto* number = value.as<std::int64_t>())
        return std::to_string(*number);
    if (const auto* number = value.as<double>())
        return std::to_string(*number);
    if (const auto* text = value.as<Text>())
        return quoted(*text);
    if (const auto* path = value.as<Object_Path>())
        return quoted(path_text(*path));
    return "NULL";
}

Object_Path normal_form(Object_Path path)
{
    path.class_name = lower_name(path.class_name);
    path.name_space = lower_name(path.name_space);
    for (Named_Value& key : path.keys)
    {
        key.name = lower_name(key.name);
        if (const auto* target = key.value.as<Object_Path>())
            key.value.content = normal_form(*target);
    }
    std::ranges::sort(path.keys, {}, [](const Named_Value& key) { return std::string_view(key.name); });
    return path;
}

} // namespace

std::string path_text(const Object_Path& path)
{
    std::string text = path.name_space.empty() ? path.class_name.string() : path.name_space + ':' + path.class_name.string();
    char separator = '.';
    for (const Named_Value& key : path.keys)
    {
        text += separator + key.name.string() + '=' + key_text(key.value);
        separator = ',';
    }
    return text;
}

std::string path_identity(const Object_Path& path) { return path_text(normal_form(path)); }

} // namespace cimserver
