#include "cmpi/cmpi_containers.h"

#include "cmpi/cmpi_objects.h"
#include "cmpi/converter.h"
#include "runtime/log.h"

#include <algorithm>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "CMPI_Containers";

} // namespace

CMPI_Container::CMPI_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space)
    : Container(repository)
    , _broker(broker)
    , _name_space(name_space)
{
}

int CMPI_Container::get_size(uint32& size)
{
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    _size = count(status);
    size = _size;
    if (okay(status))
        return 0;
    ZMLR_LOG(LL_WARN, "%s() failed", count_call());
    return -1;
}

int CMPI_Container::get_name(uint32 index, const char*& name)
{
    if (index >= _size)
    {
        ZMLR_LOG(LL_WARN, "bounds error");
        return -1;
    }
    try
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        CMPIString* cmpi_name = nullptr;
        _item = fetch(index, cmpi_name, status);
        _item_name = okay(status) ? chars_of(cmpi_name) : nullptr;
    }
    catch (...)
    {
        _item_name = nullptr;
        ZMLR_LOG(LL_WARN, "%s() threw exception: index=%u size=%u", fetch_call(), index, _size);
        return -1;
    }
    name = _item_name;
    if (name)
        return 0;
    ZMLR_LOG(LL_WARN, "%s() failed", fetch_call());
    return -1;
}

int CMPI_Container::get_value(uint32, Value::Type expected, Value& value)
{
    if (cmpi_to_cimple_value(repository(), _broker, _name_space, _item, value) != 0)
    {
        ZMLR_LOG(LL_WARN, "cmpi_to_cimple_value() failed");
        return -1;
    }
    if (value.type() != expected && !stands_for(value, expected))
    {
        ZMLR_LOG(LL_WARN, "type mismatch on %s: %s/%s", _item_name, name_of(expected), name_of(value.type()));
        return -1;
    }
    return 0;
}

int CMPI_Container::set_value(const char* name, const Value& value, uint32 flags)
{
    CMPI_Data data;
    if (_to_cmpi_data(repository(), _broker, _name_space, value, flags, data) == 0)
        return put(name, data);
    ZMLR_LOG(LL_WARN, "_to_cmpi_data() failed: feature=%s", name);
    return -1;
}

// ---- instances ----

CMPIInstance_Container::CMPIInstance_Container(const Meta_Repository* repository, const CMPIBroker* broker,
                                               const char* name_space, const CMPIInstance* instance, Kept_Keys* keys)
    : CMPI_Container(repository, broker, name_space)
    , _instance(instance)
    , _keys(keys)
{
}

int CMPIInstance_Container::set_value(const char* name, const Value& value, uint32 flags)
{
    if ((flags & Flag_Key) && _keys)
    {
        const auto kept = std::ranges::find(*_keys, name, &Kept_Key::name);
        if (kept != _keys->end())
        {
            CMPI_Data data = std::move(kept->data);
            _keys->erase(kept); // it is not needed again
            return put(name, data);
        }
    }
    return CMPI_Container::set_value(name, value, flags);
}

CMPICount CMPIInstance_Container::count(CMPIStatus& status) { return CMGetPropertyCount(_instance, &status); }

CMPIData CMPIInstance_Container::fetch(CMPICount index, CMPIString*& name, CMPIStatus& status)
{
    return CMGetPropertyAt(_instance, index, &name, &status);
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
                                                   const char* name_space, const CMPIObjectPath* path, Kept_Keys* keys)
    : CMPI_Container(repository, broker, name_space)
    , _path(path)
    , _keys(keys)
{
}

CMPICount CMPIObjectPath_Container::count(CMPIStatus& status) { return CMGetKeyCount(_path, &status); }

CMPIData CMPIObjectPath_Container::fetch(CMPICount index, CMPIString*& name, CMPIStatus& status)
{
    return CMGetKeyAt(_path, index, &name, &status);
}

int CMPIObjectPath_Container::put(const char* name, CMPI_Data& data)
{
    // Only paths that we made, which are not constant, are written.
    if (!okay(CMAddKey(const_cast<CMPIObjectPath*>(_path), name, data.value(), data.type())))
    {
        ZMLR_LOG(LL_WARN, "CMAddKey() failed");
        return -1;
    }
    if (_keys)
        _keys->push_back({name, std::move(data)});
    return 0;
}

// ---- arguments ----

CMPIArgs_Container::CMPIArgs_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                                       const CMPIArgs* args)
    : CMPI_Container(repository, broker, name_space)
    , _args(args)
{
}

CMPICount CMPIArgs_Container::count(CMPIStatus& status) { return _args ? CMGetArgCount(_args, &status) : 0; }

CMPIData CMPIArgs_Container::fetch(CMPICount index, CMPIString*& name, CMPIStatus& status)
{
    return CMGetArgAt(_args, index, &name, &status);
}

int CMPIArgs_Container::put(const char* name, CMPI_Data& data)
{
    if (eqi(name, "return_value"))
    {
        _return_value = std::move(data);
        return 0;
    }
    if (!_args)
        return 0;
    if (!okay(CMAddArg(_args, name, data.value(), data.type())))
    {
        ZMLR_LOG(LL_WARN, "CMAddArg() failed");
        return -1;
    }
    data.leave(); // not every server copies arguments
    return 0;
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
