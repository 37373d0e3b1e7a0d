// From values to CMPI data.
#include "cmpi/cmpi_containers.h"
#include "cmpi/cmpi_types.h"
#include "cmpi/converter.h"
#include "runtime/log.h"

#include <cstring>
#include <utility>
#include <vector>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Converter";

// What the objects are made with.
struct Target
{
    const Meta_Repository* repository;
    const CMPIBroker* broker;
    const char* name_space;
};

int failed(const char* what)
{
    ZMLR_LOG(LL_WARN, "%s", what);
    return -1;
}

// ---- scalars: `type` is what the data shall have ----

// Every number lies at the union's start.
template <class T>
requires std::is_arithmetic_v<T>
int to_cmpi_scalar(const Target&, CMPIType type, T x, CMPI_Data& data)
{
    CMPIValue value = {};
    std::memcpy(&value, &x, sizeof(x));
    data.set(type, value);
    return 0;
}

int to_cmpi_scalar(const Target&, CMPIType type, char16 x, CMPI_Data& data)
{
    CMPIValue value = {};
    value.char16 = x.code();
    data.set(type, value);
    return 0;
}

int to_cmpi_scalar(const Target& target, CMPIType, const String& x, CMPI_Data& data)
{
    return data.adopt(CMPI_string, CMNewString(target.broker, x.c_str(), nullptr)) ? 0 : failed("CMNewString() failed");
}

int to_cmpi_scalar(const Target& target, CMPIType, const Datetime& x, CMPI_Data& data)
{
    char text[Datetime::text_size];
    x.ascii(text);
    const bool made = data.adopt(CMPI_dateTime, CMNewDateTimeFromChars(target.broker, text, nullptr));
    return made ? 0 : failed("CMNewDateTimeFromChars() failed");
}

int to_cmpi_scalar(const Target& target, CMPIType type, const Instance* instance, CMPI_Data& data)
{
    if (!instance)
        return failed("null instance argument");
    const char* name_space = instance->__name_space.empty() ? target.name_space : instance->__name_space.c_str();
    if (!name_space || !*name_space)
        return failed("null namespace");
    const char* class_name = instance->meta_class->name;
    if (!class_name || !*class_name)
        return failed("null classname");

    CMPI_Ptr<CMPIObjectPath> path(CMNewObjectPath(target.broker, name_space, class_name, nullptr));
    if (!path)
        return failed("CMNewObjectPath() failed");
    if (CMPIObjectPath_Container(target.repository, target.broker, name_space, path.get()).convert(instance, Flag_Key) != 0)
        return failed("Container::convert() failed");
    if (type == CMPI_ref)
        return data.adopt(CMPI_ref, path.release()) ? 0 : -1;
    if (type != CMPI_instance)
        return failed("unexpected type");

    CMPI_Ptr<CMPIInstance> embedded(CMNewInstance(target.broker, path.get(), nullptr));
    if (!embedded)
        return failed("CMNewInstance() failed");
    if (CMPIInstance_Container(target.repository, target.broker, name_space, embedded.get()).convert(instance, 0) != 0)
        return failed("Container::convert() failed");
    return data.adopt(CMPI_instance, embedded.release()) ? 0 : -1;
}

// ---- arrays ----

template <class T> int to_cmpi_array(const Target& target, CMPIType element_type, const Array<T>& elements, CMPI_Data& data)
{
    CMPI_Ptr<CMPIArray> array(CMNewArray(target.broker, elements.size(), element_type, nullptr));
    if (!array)
        return failed("CMNewArray() failed");
    // What the elements point to is kept as long as the array; numbers point to nothing.
    constexpr bool number = std::is_arithmetic_v<T> || std::is_same_v<T, char16>;
    CMPI_Data::Elements made(number ? 0 : elements.size());
    CMPI_Data single;
    for (uint32 i = 0; i < elements.size(); ++i)
    {
        CMPI_Data& element = number ? single : made[i];
        if (to_cmpi_scalar(target, element_type, elements[i], element) != 0)
            return failed("element conversion failed");
        if (!okay(CMSetArrayElementAt(array.get(), i, element.value(), element.type())))
            return failed("CMSetArrayElementAt() failed");
    }
    return data.adopt(static_cast<CMPIType>(element_type | CMPI_ARRAY), array.release(), std::move(made)) ? 0 : -1;
}

template <class T> int to_cmpi(const Target& target, CMPIType element_type, const Value& value, CMPI_Data& data)
{
    if (const auto* scalar = value.get_if<T>())
        return to_cmpi_scalar(target, element_type, *scalar, data);
    if (const auto* elements = value.get_if<Array<T>>())
        return to_cmpi_array(target, element_type, *elements, data);
    return failed("unreachable");
}

CMPIType element_type_of(Value::Type scalar, uint32 flags)
{
    if (scalar == Value::INSTANCE)
        return flags & (Flag_EmbeddedObject | Flag_EmbeddedInstance) ? CMPI_instance : CMPI_ref;
    return cmpi_types[scalar].cmpi_type;
}

} // namespace

int _to_cmpi_data(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space, const Value& value,
                  uint32 flags, CMPI_Data& data)
{
    if (value.type() == Value::NONE)
        return failed("missing type");
    const bool array = is_array(value.type());
    const Value::Type scalar = array ? element_of(value.type()) : value.type();
    const CMPIType element_type = element_type_of(scalar, flags);
    if (value.null())
    {
        data.set_null(static_cast<CMPIType>(array ? element_type | CMPI_ARRAY : element_type));
        return 0;
    }

    const Target target{repository, broker, name_space};
    if (scalar == Value::INSTANCE)
        return to_cmpi<Instance*>(target, element_type, value, data);
    return with_type(scalar, [&]<class T>(std::type_identity<T>) { return to_cmpi<T>(target, element_type, value, data); });
}

} // namespace zmlr
