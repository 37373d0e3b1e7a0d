// The broker's encapsulation table: makes the objects that travel between server and module, and tells about them.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/conversion.h"
#include "cimserver/broker/message.h"
#include "cimserver/broker/objects.h"

#include <chrono>
#include <cstdio>

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
    return answer<CMPIInstance*>(status, nullptr,
                                 [&]
                                 {
                                     const Object_Path& path = object<Path_Object>(self).path;
                                     const Class_Entry& entry = known_class(broker, path.class_name.c_str());
                                     return make<Instance_Object>(entry.layout, path).face();
                                 });
}

CMPIObjectPath* new_object_path(const CMPIBroker*, const char* name_space, const char* class_name, CMPIStatus* status) noexcept
{
    return answer<CMPIObjectPath*>(
        status, nullptr,
        [&] {
            return make<Path_Object>(Object_Path{"", name_space ? name_space : "", required(class_name), {}}).face();
        });
}

CMPIArgs* new_args(const CMPIBroker*, CMPIStatus* status) noexcept
{
    return answer<CMPIArgs*>(status, nullptr, [] { return make<Args_Object>().face(); });
}

CMPIString* new_string(const CMPIBroker*, const char* text, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr, [&] { return make<String_Object>(required(text)).face(); });
}

CMPIArray* new_array(const CMPIBroker*, CMPICount size, CMPIType element_type, CMPIStatus* status) noexcept
{
    return answer<CMPIArray*>(status, nullptr, [&] { return make<Array_Object>(size, element_type).face(); });
}

CMPIDateTime* new_date_time(const CMPIBroker*, CMPIStatus* status) noexcept
{
    return answer<CMPIDateTime*>(
        status, nullptr,
        []
        {
            namespace chrono = std::chrono;
            const auto now = chrono::duration_cast<chrono::microseconds>(chrono::system_clock::now().time_since_epoch());
            return make<Datetime_Object>(Datetime_Value{static_cast<std::uint64_t>(now.count()), false}).face();
        });
}

CMPIDateTime* new_date_time_from_binary(const CMPIBroker*, CMPIUint64 usec, CMPIBoolean interval, CMPIStatus* status) noexcept
{
    return answer<CMPIDateTime*>(status, nullptr,
                                 [&] {
                                     return make<Datetime_Object>(Datetime_Value{usec, interval != 0}).face();
                                 });
}

CMPIDateTime* new_date_time_from_chars(const CMPIBroker*, const char* text, CMPIStatus* status) noexcept
{
    return answer<CMPIDateTime*>(status, nullptr, [&] { return make<Datetime_Object>(std::string(required(text))).face(); });
}

// Null when there is no text.
CMPIArray* array_of_texts(const std::vector<std::string>& texts)
{
    std::vector<Value> elements;
    for (const std::string& text : texts)
        elements.push_back({CMPI_string, text});
    return elements.empty() ? nullptr : make<Array_Object>(CMPIType{CMPI_string}, std::move(elements)).face();
}

CMPISelectExp* new_select_exp(const CMPIBroker*, const char* query, const char*, CMPIArray** projection,
                              CMPIStatus* status) noexcept
{
    return answer<CMPISelectExp*>(status, nullptr,
                                  [&]
                                  {
                                      auto& select = make<Select_Object>(required(query));
                                      if (projection)
                                          *projection = array_of_texts(select.projection);
                                      return select.face();
                                  });
}

CMPIBoolean class_path_is_a(const CMPIBroker* broker, const CMPIObjectPath* path, const char* class_name,
                            CMPIStatus* status) noexcept
{
    return answer<CMPIBoolean>(status, 0,
                               [&]
                               {
                                   const auto& own = known_class(broker, object<Path_Object>(path).path.class_name.c_str());
                                   const auto& ancestor = known_class(broker, required(class_name));
                                   return Repository::is_a(own.meta_class, ancestor.meta_class);
                               });
}

// How every object begins, whatever its type.
struct Any_Handle
{
    void* hdl;
    const void* ft;
};

struct Object_Type
{
    const void* table;
    const char* name;
};

const Object_Type& type_of(const void* object)
{
    static const Object_Type types[] = {
        {&String_Object::table, "CMPIString"},     {&Array_Object::table, "CMPIArray"},
        {&Datetime_Object::table, "CMPIDateTime"}, {&Path_Object::table, "CMPIObjectPath"},
        {&Instance_Object::table, "CMPIInstance"}, {&Args_Object::table, "CMPIArgs"},
        {&Context_Object::table, "CMPIContext"},   {&Result_Object::table, "CMPIResult"},
        {&Select_Object::table, "CMPISelectExp"},  {&Enumeration_Object::table, "CMPIEnumeration"},
    };
    const auto* handle = static_cast<const Any_Handle*>(object);
    for (const Object_Type& type : types)
        if (handle && handle->hdl && handle->ft == type.table)
            return type;
    throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
}

std::string text_of(const void* self)
{
    const Object_Type& type = type_of(self);
    if (type.table == &String_Object::table)
        return object<String_Object>(static_cast<const CMPIString*>(self)).text;
    if (type.table == &Datetime_Object::table)
        return object<Datetime_Object>(static_cast<const CMPIDateTime*>(self)).text;
    if (type.table == &Path_Object::table)
        return path_text(object<Path_Object>(static_cast<const CMPIObjectPath*>(self)).path);
    if (type.table == &Instance_Object::table)
        return path_text(object<Instance_Object>(static_cast<const CMPIInstance*>(self)).path);
    if (type.table == &Select_Object::table)
        return object<Select_Object>(static_cast<const CMPISelectExp*>(self)).query;
    return type.name;
}

CMPIString* to_string(const CMPIBroker*, const void* self, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr, [&] { return make<String_Object>(text_of(self)).face(); });
}

CMPIBoolean is_of_type(const CMPIBroker*, const void* self, const char* type, CMPIStatus* status) noexcept
{
    return answer<CMPIBoolean>(status, 0, [&] { return std::string(type_of(self).name) == required(type); });
}

CMPIString* get_type(const CMPIBroker*, const void* self, CMPIStatus* status) noexcept
{
    return answer<CMPIString*>(status, nullptr, [&] { return make<String_Object>(type_of(self).name).face(); });
}

CMPIString* get_message(const CMPIBroker*, const char*, const char* default_text, CMPIStatus* status, CMPICount count,
                        ...) noexcept
{
    va_list arguments;
    va_start(arguments, count);
    CMPIString* message = answer<CMPIString*>(
        status, nullptr, [&] { return make<String_Object>(format_message(required(default_text), count, &arguments)).face(); });
    va_end(arguments);
    return message;
}

CMPIStatus log_message(const CMPIBroker*, int severity, const char* id, const char* text, const CMPIString* string) noexcept
{
    return answer(
        [&]
        {
            const char* message = text ? text : object<String_Object>(string).text.c_str();
            std::fprintf(stderr, "%s: severity %d: %s\n", id ? id : "module", severity, message);
        });
}

CMPIStatus trace(const CMPIBroker*, int, const char*, const char*, const CMPIString*) noexcept { return {CMPI_RC_OK, nullptr}; }

} // namespace

const CMPIBrokerEncFT encapsulation_table = {
    .ftVersion = 100,
    .newInstance = new_instance,
    .newObjectPath = new_object_path,
    .newArgs = new_args,
    .newString = new_string,
    .newArray = new_array,
    .newDateTime = new_date_time,
    .newDateTimeFromBinary = new_date_time_from_binary,
    .newDateTimeFromChars = new_date_time_from_chars,
    .newSelectExp = new_select_exp,
    .classPathIsA = class_path_is_a,
    .toString = to_string,
    .isOfType = is_of_type,
    .getType = get_type,
    .getMessage = get_message,
    .logMessage = log_message,
    .trace = trace,
};

} // namespace cimserver
