// The containers around CMPI objects: an instance's properties, an object path's keys, a method's arguments.
//
// A container borrows what it is given: the object that it wraps, and the name space where references without one of their own
// point to.
#pragma once

#include "cmpi/cmpi_data.h"
#include "cmpi/container.h"

#include <cmpift.h>

#include <memory_resource>
#include <vector>

namespace zmlr
{

// What the containers share: items as the broker holds them, converted on their way in and out.
class CMPI_Container : public Container
{
public:
    CMPI_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space);

    int get_size(uint32& size) override;
    int get_name(uint32 index, const char*& name) override;
    int get_value(uint32 index, Value::Type expected, Value& value) override;
    int set_value(const char* name, const Value& value, uint32 flags) override;

private:
    // The broker's calls, and what they are called in the log.
    virtual CMPICount count(CMPIStatus& status) = 0;
    virtual CMPIData fetch(CMPICount index, CMPIString*& name, CMPIStatus& status) = 0;
    virtual int put(const char* name, CMPI_Data& data) = 0; // 0, or -1 and a log line; may take the data over
    virtual const char* count_call() const = 0;
    virtual const char* fetch_call() const = 0;

    // Whether a value that is not of the expected type stands for one that is, which it then becomes.
    virtual bool stands_for(Value&, Value::Type) const { return false; }

    const CMPIBroker* _broker;
    const char* _name_space;
    uint32 _size = 0;
    CMPIData _item = {CMPI_null, CMPI_nullValue, {.uint64 = 0}}; // the one that was fetched last
    const char* _item_name = "";
};

// A key as it was added to a path, to be set as a property too: it is converted once.
struct Kept_Key
{
    const char* name; // the feature's
    CMPI_Data data;
};
using Kept_Keys = std::pmr::vector<Kept_Key>;

// A key that is among the kept ones is set as it is there.
class CMPIInstance_Container : public CMPI_Container
{
public:
    CMPIInstance_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                           const CMPIInstance* instance, Kept_Keys* keys = nullptr);

    int set_value(const char* name, const Value& value, uint32 flags) override;

private:
    CMPICount count(CMPIStatus& status) override;
    CMPIData fetch(CMPICount index, CMPIString*& name, CMPIStatus& status) override;
    int put(const char* name, CMPI_Data& data) override;
    const char* count_call() const override { return "CMGetPropertyCount"; }
    const char* fetch_call() const override { return "CMGetPropertyAt"; }

    const CMPIInstance* _instance;
    Kept_Keys* _keys;
};

// A container for a constant path may only be read. The data of what is added are kept where somebody wants them.
class CMPIObjectPath_Container : public CMPI_Container
{
public:
    CMPIObjectPath_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                             const CMPIObjectPath* path, Kept_Keys* keys = nullptr);

private:
    CMPICount count(CMPIStatus& status) override;
    CMPIData fetch(CMPICount index, CMPIString*& name, CMPIStatus& status) override;
    int put(const char* name, CMPI_Data& data) override;
    const char* count_call() const override { return "CMGetKeyCount"; }
    const char* fetch_call() const override { return "CMGetKeyAt"; }

    const CMPIObjectPath* _path;
    Kept_Keys* _keys;
};

// A container without arguments (null) is empty, and drops what it is given. What is set under the name "return_value" is no
// argument: it goes into a slot of its own.
class CMPIArgs_Container : public CMPI_Container
{
public:
    CMPIArgs_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space, const CMPIArgs* args);

    CMPI_Data& return_value() { return _return_value; }

private:
    CMPICount count(CMPIStatus& status) override;
    CMPIData fetch(CMPICount index, CMPIString*& name, CMPIStatus& status) override;
    int put(const char* name, CMPI_Data& data) override;
    const char* count_call() const override { return "CMGetArgCount"; }
    const char* fetch_call() const override { return "CMGetArgAt"; }
    bool stands_for(Value& value, Value::Type expected) const override;

    const CMPIArgs* _args;
    CMPI_Data _return_value;
};

} // namespace zmlr
