// The broker's encapsulation table: makes the objects that travel between server and module.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

const Class_Entry& known_class(const CMPIBroker* broker, const char* class_name)
{
    const Class_Entry* entry = broker_of(broker).repository().find(class_name);
    if (!entry)
        throw Failure{CMPI_RC_ERR_INVALID_CLASS};
    return *entry;
}

CMPIInstance* new_instance(const CMPIBroker* broker, const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        const Object_Path& path = object<Path_Object>(self).path;
        return make<Instance_Object>(known_class(broker, path.class_name.c_str()).layout, path).face();
    };
    return answer<CMPIInstance*>(status, nullptr, body);
}

CMPIObjectPath* new_object_path(const CMPIBroker*, const char* name_space, const char* class_name, CMPIStatus* status) noexcept
{
    const auto path = [&] { return Object_Path{"", name_space ? name_space : "", required(class_name), {}}; };
    return answer_new<Path_Object>(status, path);
}

CMPIArgs* new_args(const CMPIBroker*, CMPIStatus* status) noexcept
{
    return answer<CMPIArgs*>(status, nullptr, [] { return make<Args_Object>().face(); });
}

CMPIString* new_string(const CMPIBroker*, const char* text, CMPIStatus* status) noexcept
{
    return answer_new<String_Object>(status, [&] { return required(text); });
}

CMPIArray* new_array(const CMPIBroker*, CMPICount size, CMPIType element_type, CMPIStatus* status) noexcept
{
    return answer<CMPIArray*>(status, nullptr, [&] { return make<Array_Object>(size, element_type).face(); });
}

CMPIDateTime* new_date_time_from_chars(const CMPIBroker*, const char* text, CMPIStatus* status) noexcept
{
    return answer_new<Datetime_Object>(status, [&] { return std::string(required(text)); });
}

} // namespace

const CMPIBrokerEncFT encapsulation_table = {
    .ftVersion = 100,
    .newInstance = new_instance,
    .newObjectPath = new_object_path,
    .newArgs = new_args,
    .newString = new_string,
    .newArray = new_array,
    .newDateTime = not_offered,
    .newDateTimeFromBinary = not_offered,
    .newDateTimeFromChars = new_date_time_from_chars,
    .newSelectExp = not_offered,
    .classPathIsA = not_offered,
    .toString = not_offered,
    .isOfType = not_offered,
    .getType = not_offered,
    .getMessage = not_offered,
    .logMessage = not_offered,
    .trace = not_offered,
};

} // namespace cimserver
