#include "cimserver/path_identity.h"

#include "cimserver/broker/conversion.h"
#include "cimserver/broker/names.h"

#include <algorithm>

namespace cimserver
{
namespace
{

Object_Path normal_form(Object_Path path)
{
    path.class_name = lower_name(path.class_name);
    path.name_space = lower_name(path.name_space);
    for (Named_Value& key : path.keys)
    {
        key.name = lower_name(key.name);
        if (auto* target = std::get_if<std::shared_ptr<const Object_Path>>(&key.value.content); target && *target)
            *target = std::make_shared<const Object_Path>(normal_form(**target));
    }
    std::ranges::sort(path.keys, {}, &Named_Value::name);
    return path;
}

} // namespace

std::string path_identity(const Object_Path& path) { return path_text(normal_form(path)); }

} // namespace cimserver
