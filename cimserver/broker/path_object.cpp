#include "cimserver/broker/conversion.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIStatus set_text(CMPIObjectPath* self, std::string Object_Path::*member, const char* text) noexcept
{
    return answer([&] { object<Path_Object>(self).path.*member = required(text); });
}

CMPIString* get_text(const CMPIObjectPath* self, std::string Object_Path::*member, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr,
                               [&] { return make<String_Object>(object<Path_Object>(self).path.*member).face(); });
}

CMPIStatus set_name_space(CMPIObjectPath* self, const char* text) noexcept
{
    return set_text(self, &Object_Path::name_space, text);
}

CMPIString* get_name_space(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return get_text(self, &Object_Path::name_space, status);
}

CMPIStatus set_hostname(CMPIObjectPath* self, const char* text) noexcept { return set_text(self, &Object_Path::host, text); }

CMPIString* get_hostname(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return get_text(self, &Object_Path::host, status);
}

CMPIStatus set_class_name(CMPIObjectPath* self, const char* text) noexcept
{
    return set_text(self, &Object_Path::class_name, text);
}

CMPIString* get_class_name(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return get_text(self, &Object_Path::class_name, status);
}

CMPIStatus add_key(CMPIObjectPath* self, const char* name, const CMPIValue* value, CMPIType type) noexcept
{
    return answer(
        [&]
        {
            auto& path = object<Path_Object>(self).path;
            Value key = from_cmpi(value, type);
            if (key.null() || (key.type & CMPI_ARRAY) != 0)
                throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
            put(path.keys, name, std::move(key));
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

CMPIStatus set_name_space_from(CMPIObjectPath* self, const CMPIObjectPath* source) noexcept
{
    return answer([&] { object<Path_Object>(self).path.name_space = object<Path_Object>(source).path.name_space; });
}

CMPIStatus set_host_and_name_space_from(CMPIObjectPath* self, const CMPIObjectPath* source) noexcept
{
    return answer(
        [&]
        {
            auto& path = object<Path_Object>(self).path;
            const auto& from = object<Path_Object>(source).path;
            path.host = from.host;
            path.name_space = from.name_space;
        });
}

CMPIString* to_string(const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr,
                               [&] { return make<String_Object>(path_text(object<Path_Object>(self).path)).face(); });
}

CMPIData no_class_qualifier(const CMPIObjectPath*, const char*, CMPIStatus* status) noexcept
{
    return not_supported(status, no_data());
}

CMPIData no_feature_qualifier(const CMPIObjectPath*, const char*, const char*, CMPIStatus* status) noexcept
{
    return not_supported(status, no_data());
}

CMPIData no_parameter_qualifier(const CMPIObjectPath*, const char*, const char*, const char*, CMPIStatus* status) noexcept
{
    return not_supported(status, no_data());
}

} // namespace

const CMPIObjectPathFT Path_Object::table = {
    .ftVersion = 100,
    .release = release<Path_Object>,
    .clone = clone<Path_Object>,
    .setNameSpace = set_name_space,
    .getNameSpace = get_name_space,
    .setHostname = set_hostname,
    .getHostname = get_hostname,
    .setClassName = set_class_name,
    .getClassName = get_class_name,
    .addKey = add_key,
    .getKey = get_key,
    .getKeyAt = get_key_at,
    .getKeyCount = get_key_count,
    .setNameSpaceFromObjectPath = set_name_space_from,
    .setHostAndNameSpaceFromObjectPath = set_host_and_name_space_from,
    .getClassQualifier = no_class_qualifier,
    .getPropertyQualifier = no_feature_qualifier,
    .getMethodQualifier = no_feature_qualifier,
    .getParameterQualifier = no_parameter_qualifier,
    .toString = to_string,
};

} // namespace cimserver
