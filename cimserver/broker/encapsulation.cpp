// The broker's encapsulation table: makes the objects that travel between server and module.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/not_offered.h"
#include "cimserver/broker/objects.h"

namespace cimserver
{
namespace
{

CMPIInstance* new_instance(const CMPIBroker* broker, const CMPIObjectPath* self, CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        const Repository& classes = broker_of(broker).repository();
        const auto& path = object<Path_Object>(self);
        const Class_Entry* entry = path.class_entry ? path.class_entry : classes.find(path.path.class_name);
        if (!entry)
            throw Failure{CMPI_RC_ERR_INVALID_CLASS};
        return make<Instance_Object>(entry->layout, path.path).face();
    };
    return answer<CMPIInstance*>(status, nullptr, body);
}

CMPIObjectPath* new_object_path(const CMPIBroker* broker, const char* name_space, const char* class_name,
                                CMPIStatus* status) noexcept
{
    const auto body = [&]
    {
        const Class_Entry* entry = broker_of(broker).repository().find(required(class_name));
        return make<Path_Object>(Object_Path{{}, name_space ? name_space : "", entry ? entry->name : class_name, {}}, entry)
            .face();
    };
    return answer<CMPIObjectPath*>(status, nullptr, body);
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
    return answer_new<Datetime_Object>(status, [&] { return required(text); });
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
