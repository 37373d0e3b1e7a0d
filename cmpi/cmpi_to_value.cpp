// From CMPI data to values.
#include "cmpi/cmpi_containers.h"
#include "cmpi/cmpi_types.h"
#include "cmpi/converter.h"
#include "runtime/log.h"

#include <cstring>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Converter";

// Where references and embedded objects are looked up.
struct Source
{
    const Meta_Repository* repository;
    const CMPIBroker* broker;
    const char* name_space;
};

// ---- scalars ----

// Every number lies at the union's start.
template <class T>
requires std::is_arithmetic_v<T>
int from_cmpi(const CMPIValue& value, T& x)
{
    std::memcpy(&x, &value, sizeof(x));
    return 0;
}

int from_cmpi(const CMPIValue& value, boolean& x)
{
    x = value.boolean != 0;
    return 0;
}

int from_cmpi(const CMPIValue& value, char16& x)
{
    x = char16(value.char16);
    return 0;
}

int from_cmpi(const CMPIValue& value, String& x)
{
    x.clear();
    if (!value.string)
    {
        ZMLR_LOG(LL_INFO, "ignored null CMPI string");
        return 0;
    }
    if (const char* text = chars_of(value.string))
        x = text;
    else
        ZMLR_LOG(LL_WARN, "CMGetCharsPtr() failed");
    return 0;
}

int from_cmpi(const CMPIValue& value, Datetime& x)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIString* string = value.dateTime ? CMGetStringFormat(value.dateTime, &status) : nullptr;
    const char* text = okay(status) ? chars_of(string) : nullptr;
    if (!text)
    {
        ZMLR_LOG(LL_WARN, "CMGetStringFormat() failed");
        return -1;
    }
    return x.set(text) ? 0 : -1;
}

template <class T> int scalar_from_cmpi(const CMPIData& data, Value& value)
{
    T x{};
    if (from_cmpi(data.value, x) != 0)
    {
        ZMLR_LOG(LL_WARN, "conversion error");
        return -1;
    }
    value.set_value(x);
    return 0;
}

// ---- references and embedded objects ----

const Meta_Class* class_of(const Source& source, const CMPIObjectPath* path)
{
    const String name = class_name_of(path);
    if (name.empty())
    {
        ZMLR_LOG(LL_WARN, "CMGetClassName() failed");
        return nullptr;
    }
    const Meta_Class* meta_class = find_meta_class(source.repository, name.c_str());
    if (!meta_class)
        ZMLR_LOG(LL_WARN, "failed to find meta class: %s", name.c_str());
    return meta_class;
}

// The keys of a referenced object, the properties of an embedded one; empty on failure.
Ref<Instance> _to_cimple_instance(const Source& source, const CMPIObjectPath* path)
{
    Ref<Instance> instance;
    if (!path)
    {
        ZMLR_LOG(LL_WARN, "null instance");
        return instance;
    }
    if (const Meta_Class* meta_class = class_of(source, path))
        CMPIObjectPath_Container(source.repository, source.broker, source.name_space, path)
            .convert(meta_class, Flag_Key, instance);
    return instance;
}

Ref<Instance> _to_cimple_instance(const Source& source, const CMPIInstance* cmpi_instance)
{
    Ref<Instance> instance;
    if (!cmpi_instance)
    {
        ZMLR_LOG(LL_WARN, "null instance");
        return instance;
    }
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIObjectPath* path = CMGetObjectPath(cmpi_instance, &status);
    if (!path || !okay(status))
    {
        ZMLR_LOG(LL_WARN, "CMGetObjectPath() failed");
        return instance;
    }
    if (const Meta_Class* meta_class = class_of(source, path))
        CMPIInstance_Container(source.repository, source.broker, source.name_space, cmpi_instance)
            .convert(meta_class, 0, instance);
    return instance;
}

// Objects within objects come as deep as a client nests them, and a server's thread has only so much stack.
constexpr unsigned deepest = 16;
constinit thread_local unsigned depth = 0;

class Nesting
{
public:
    Nesting() { ++depth; }
    ~Nesting() { --depth; }
    Nesting(const Nesting&) = delete;
    Nesting& operator=(const Nesting&) = delete;
};

Ref<Instance> _to_cimple_instance(const Source& source, CMPIType type, const CMPIValue& value)
{
    const Nesting nesting;
    Ref<Instance> instance;
    if (depth <= deepest)
        instance = type == CMPI_ref ? _to_cimple_instance(source, value.ref) : _to_cimple_instance(source, value.inst);
    if (!instance)
        ZMLR_LOG(LL_WARN, "failed to create CIMPLE instance");
    return instance;
}

int instance_from_cmpi(const Source& source, const CMPIData& data, Value& value)
{
    Ref<Instance> instance = _to_cimple_instance(source, data.type, data.value);
    if (!instance)
        return -1;
    value.set_value(instance.steal());
    return 0;
}

// ---- arrays ----

// Calls f(element) for every element until it answers other than 0. `mismatch` and `null` are what is logged of an element
// of another type and of a null one.
template <class F> int for_each_element(const CMPIData& data, const char* mismatch, const char* null, F f)
{
    const CMPIArray* array = data.value.array;
    if (!array)
    {
        ZMLR_LOG(LL_WARN, "null array");
        return -1;
    }
    const auto element_type = static_cast<CMPIType>(data.type & ~CMPI_ARRAY);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPICount size = CMGetArrayCount(array, &status);
    if (!okay(status))
    {
        ZMLR_LOG(LL_WARN, "CMGetArrayCount() failed");
        return -1;
    }
    for (CMPICount i = 0; i < size; ++i)
    {
        const CMPIData element = CMGetArrayElementAt(array, i, &status);
        if (!okay(status) || element.type != element_type)
        {
            ZMLR_LOG(LL_WARN, "%s", mismatch);
            return -1;
        }
        if (CMIsNullValue(element))
        {
            ZMLR_LOG(LL_WARN, "%s", null);
            return -1;
        }
        if (f(element) != 0)
            return -1;
    }
    return 0;
}

template <class T> int array_from_cmpi(const CMPIData& data, Value& value)
{
    Array<T> array;
    const auto append = [&](const CMPIData& element)
    {
        T x{};
        if (from_cmpi(element.value, x) != 0)
        {
            ZMLR_LOG(LL_WARN, "conversion error");
            return -1;
        }
        array.append(x);
        return 0;
    };
    if (for_each_element(data, "type mismatch", "encountered null array element", append) != 0)
        return -1;
    value.set_value(std::move(array));
    return 0;
}

int instance_array_from_cmpi(const Source& source, const CMPIData& data, Value& value)
{
    Instance_Array array;
    const auto append = [&](const CMPIData& element)
    {
        Ref<Instance> instance = _to_cimple_instance(source, element.type, element.value);
        if (!instance)
            return -1;
        array.adopt(std::move(instance));
        return 0;
    };
    if (for_each_element(data, "array element type mismatch", "encountered null instance element", append) != 0)
        return -1;
    value.set_value(static_cast<Array<Instance*>&&>(array)); // takes over the references
    return 0;
}

// The type of the values that data of a CMPI type become; NONE for one that has none.
Value::Type value_type_of(CMPIType cmpi_type)
{
    const bool array = (cmpi_type & CMPI_ARRAY) != 0;
    const auto element = static_cast<CMPIType>(cmpi_type & ~CMPI_ARRAY);
    if (element == CMPI_ref || element == CMPI_instance)
        return array ? Value::INSTANCE_ARRAY : Value::INSTANCE;
    for (const CMPI_Type_Row& row : cmpi_types)
    {
        if (row.cmpi_type == element)
            return array ? Value::array_of(row.type) : row.type;
    }
    return Value::NONE;
}

} // namespace

int cmpi_to_cimple_value(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                         const CMPIData& data, Value& value)
{
    const Source source{repository, broker, name_space};
    const Value::Type type = value_type_of(data.type);
    if (type == Value::NONE)
    {
        ZMLR_LOG(LL_WARN, "unknown type");
        return -1;
    }
    if (CMIsNullValue(data))
    {
        value.set_null(type);
        return 0;
    }
    if (type == Value::INSTANCE)
        return instance_from_cmpi(source, data, value);
    if (type == Value::INSTANCE_ARRAY)
        return instance_array_from_cmpi(source, data, value);
    if (is_array(type))
        return with_type(element_of(type), [&]<class T>(std::type_identity<T>) { return array_from_cmpi<T>(data, value); });
    return with_type(type, [&]<class T>(std::type_identity<T>) { return scalar_from_cmpi<T>(data, value); });
}

} // namespace zmlr
