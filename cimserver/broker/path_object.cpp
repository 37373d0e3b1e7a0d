#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"
#include "cimserver/model/paths.h"

namespace cimserver
{
namespace
{

CMPIString* get_name_space(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return object<Path_Object>(self).path.name_space; });
}

CMPIString* get_class_name(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return object<Path_Object>(self).path.class_name; });
}

CMPIStatus add_key(CMPIObjectPath* self, const char* name, const CMPIValue* value, CMPIType type) noexcept
{
    return answer(
        [&]
        {
            auto& path = object<Path_Object>(self);
            Value key = from_cmpi(value, type);
            if (key.null() || (key.type & CMPI_ARRAY) != 0)
                throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
            const auto place = path.class_entry ? path.class_entry->layout->find(required(name)) : std::nullopt;
            put(path.path.keys, place ? (*path.class_entry->layout)[*place].name : Name(required(name)), std::move(key));
        });
}

CMPIData marked_as_key(CMPIData data)
{
    data.state = CMPI_keyValue;
    return data;
}

CMPIData get_key(const CMPIObjectPath* self, const char* name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return marked_as_key(data_named(object<Path_Object>(self).path.keys, name)); });
}

CMPIData get_key_at(const CMPIObjectPath* self, CMPICount index, CMPIString** name, CMPIStatus* status) noexcept
{
    return answer(status, no_data(), [&] { return marked_as_key(data_at(object<Path_Object>(self).path.keys, index, name)); });
}

CMPICount get_key_count(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return answer<CMPICount>(status, 0, [&] { return static_cast<CMPICount>(object<Path_Object>(self).path.keys.size()); });
}

CMPIString* to_string(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return path_text(object<Path_Object>(self).path); });
}

} // namespace

const CMPIObjectPathFT Path_Object::table = {
    .ftVersion = 100,
    .release = release<Path_Object>,
    .clone = clone<Path_Object>,
    .setNameSpace = not_offered,
    .getNameSpace = get_name_space,
    .setHostname = not_offered,
    .getHostname = not_offered,
    .setClassName = not_offered,
    .getClassName = get_class_name,
    .addKey = add_key,
    .getKey = get_key,
    .getKeyAt = get_key_at,
    .getKeyCount = get_key_count,
    .setNameSpaceFromObjectPath = not_offered,
    .setHostAndNameSpaceFromObjectPath = not_offered,
    .getClassQualifier = not_offered,
    .getPropertyQualifier = not_offered,
    .getMethodQualifier = not_offered,
    .getParameterQualifier = not_offered,
    .toString = to_string,
};

} // namespace cimserver
