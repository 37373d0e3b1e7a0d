#include "cmpi/cmpi_containers.h"

#include "cmpi/cmpi_objects.h"
#include "cmpi/converter.h"
#include "runtime/log.h"

#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "CMPI_Containers";

bool in_bounds(uint32 index, uint32 size)
{
    if (index < size)
        return true;
    ZMLR_LOG(LL_WARN, "bounds error");
    return false;
}

// The name that came with an item; false when there is none.
bool take_name(const CMPIString* cmpi_name, String& name)
{
    const char* text = chars_of(cmpi_name);
    if (!text)
        return false;
    name = text;
    return true;
}

} // namespace

CMPI_Container::CMPI_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space)
    : Container(repository)
    , _broker(broker)
    , _name_space(name_space)
{
}

int CMPI_Container::get_name(uint32 index, String& name)
{
    CMPIData data;
    return fetch(index, data, name);
}

int CMPI_Container::get_value(uint32 index, Value::Type expected, Value& value)
{
    CMPIData data;
    String name;
    if (fetch(index, data, name) != 0)
        return -1;
    if (cmpi_to_cimple_value(repository(), _broker, _name_space.c_str(), data, value) != 0)
    {
        ZMLR_LOG(LL_WARN, "cmpi_to_cimple_value() failed");
        return -1;
    }
    if (value.type() != expected && !stands_for(value, expected))
    {
        ZMLR_LOG(LL_WARN, "type mismatch on %s: %s/%s", name.c_str(), name_of(expected), name_of(value.type()));
        return -1;
    }
    return 0;
}

int CMPI_Container::set_value(const char* name, const Value& value, uint32 flags)
{
    CMPI_Data data;
    if (_to_cmpi_data(repository(), _broker, _name_space.c_str(), value, flags, data) == 0)
        return put(name, data);
    ZMLR_LOG(LL_WARN, "_to_cmpi_data() failed: feature=%s", name);
    return -1;
}

// ---- instances ----

CMPIInstance_Container::CMPIInstance_Container(const Meta_Repository* repository, const CMPIBroker* broker,
                                               const char* name_space, const CMPIInstance* instance)
    : CMPI_Container(repository, broker, name_space)
    , _instance(instance)
{
}

uint32 CMPIInstance_Container::get_size() { return CMGetPropertyCount(_instance, nullptr); }

int CMPIInstance_Container::fetch(uint32 index, CMPIData& data, String& name)
{
    const uint32 size = get_size();
    if (!in_bounds(index, size))
        return -1;
    try
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        CMPIString* cmpi_name = nullptr;
        data = CMGetPropertyAt(_instance, index, &cmpi_name, &status);
        if (okay(status) && take_name(cmpi_name, name))
            return 0;
        ZMLR_LOG(LL_WARN, "CMGetPropertyAt() failed");
    }
    catch (...)
    {
        ZMLR_LOG(LL_WARN, "CMGetPropertyAt() threw exception: index=%u size=%u", index, size);
    }
    return -1;
}

int CMPIInstance_Container::put(const char* name, CMPI_Data& data)
{
    if (okay(CMSetProperty(_instance, name, data.value(), data.type())))
        return 0;
    ZMLR_LOG(LL_WARN, "CMSetProperty() failed: %s", name);
    return -1;
}

// ---- object paths ----

CMPIObjectPath_Container::CMPIObjectPath_Container(const Meta_Repository* repository, const CMPIBroker* broker,
                                                   const char* name_space, const CMPIObjectPath* path)
    : CMPI_Container(repository, broker, name_space)
    , _path(path)
{
}

uint32 CMPIObjectPath_Container::get_size() { return CMGetKeyCount(_path, nullptr); }

int CMPIObjectPath_Container::fetch(uint32 index, CMPIData& data, String& name)
{
    if (!in_bounds(index, get_size()))
        return -1;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    CMPIString* cmpi_name = nullptr;
    data = CMGetKeyAt(_path, index, &cmpi_name, &status);
    if (okay(status) && take_name(cmpi_name, name))
        return 0;
    ZMLR_LOG(LL_WARN, "CMGetKeyAt() failed");
    return -1;
}

int CMPIObjectPath_Container::put(const char* name, CMPI_Data& data)
{
    // Only paths that we made, which are not constant, are written.
    if (okay(CMAddKey(const_cast<CMPIObjectPath*>(_path), name, data.value(), data.type())))
        return 0;
    ZMLR_LOG(LL_WARN, "CMAddKey() failed");
    return -1;
}

// ---- arguments ----

CMPIArgs_Container::CMPIArgs_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                                       const CMPIArgs* args)
    : CMPI_Container(repository, broker, name_space)
    , _args(args)
{
}

uint32 CMPIArgs_Container::get_size() { return _args ? CMGetArgCount(_args, nullptr) : 0; }

int CMPIArgs_Container::fetch(uint32 index, CMPIData& data, String& name)
{
    if (!in_bounds(index, get_size()))
        return -1;
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    CMPIString* cmpi_name = nullptr;
    data = CMGetArgAt(_args, index, &cmpi_name, &status);
    if (okay(status) && take_name(cmpi_name, name))
        return 0;
    ZMLR_LOG(LL_WARN, "CMGetArgAt() failed");
    return -1;
}

int CMPIArgs_Container::put(const char* name, CMPI_Data& data)
{
    if (eqi(name, "return_value"))
    {
        _return_value = std::move(data);
        return 0;
    }
    if (!_args || okay(CMAddArg(_args, name, data.value(), data.type())))
        return 0;
    ZMLR_LOG(LL_WARN, "CMAddArg() failed");
    return -1;
}

// Servers deliver untyped nulls as booleans.
bool CMPIArgs_Container::stands_for(Value& value, Value::Type expected) const
{
    if (value.type() != Value::BOOLEAN || expected != Value::INSTANCE_ARRAY)
        return false;
    value.set_null(Value::INSTANCE_ARRAY);
    return true;
}

} // namespace zmlr
