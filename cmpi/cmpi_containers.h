// The containers around CMPI objects: an instance's properties, an object path's keys, a method's arguments.
//
// A container borrows the object it wraps. `name_space` is where references without a name space of their own point to.
#pragma once

#include "cmpi/cmpi_data.h"
#include "cmpi/container.h"

#include <cmpift.h>

namespace zmlr
{

// What the containers share: items as the broker holds them, converted on their way in and out.
class CMPI_Container : public Container
{
public:
    CMPI_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space);

    int get_name(uint32 index, String& name) override;
    int get_value(uint32 index, Value::Type expected, Value& value) override;
    int set_value(const char* name, const Value& value, uint32 flags) override;

private:
    // Each answers 0, or -1 and a log line.
    virtual int fetch(uint32 index, CMPIData& data, String& name) = 0;
    virtual int put(const char* name, CMPI_Data& data) = 0;

    // Whether a value that is not of the expected type stands for one that is, which it then becomes.
    virtual bool stands_for(Value&, Value::Type) const { return false; }

    const CMPIBroker* _broker;
    String _name_space;
};

class CMPIInstance_Container : public CMPI_Container
{
public:
    CMPIInstance_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                           const CMPIInstance* instance);

    uint32 get_size() override;

private:
    int fetch(uint32 index, CMPIData& data, String& name) override;
    int put(const char* name, CMPI_Data& data) override;

    const CMPIInstance* _instance;
};

// A container for a constant path may only be read.
class CMPIObjectPath_Container : public CMPI_Container
{
public:
    CMPIObjectPath_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space,
                             const CMPIObjectPath* path);

    uint32 get_size() override;

private:
    int fetch(uint32 index, CMPIData& data, String& name) override;
    int put(const char* name, CMPI_Data& data) override;

    const CMPIObjectPath* _path;
};

// A container without arguments (null) is empty, and drops what it is given. What is set under the name "return_value" is no
// argument: it goes into a slot of its own.
class CMPIArgs_Container : public CMPI_Container
{
public:
    CMPIArgs_Container(const Meta_Repository* repository, const CMPIBroker* broker, const char* name_space, const CMPIArgs* args);

    uint32 get_size() override;
    CMPI_Data& return_value() { return _return_value; }

private:
    int fetch(uint32 index, CMPIData& data, String& name) override;
    int put(const char* name, CMPI_Data& data) override;
    bool stands_for(Value& value, Value::Type expected) const override;

    const CMPIArgs* _args;
    CMPI_Data _return_value;
};

} // namespace zmlr
