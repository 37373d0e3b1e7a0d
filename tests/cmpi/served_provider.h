// A provider served by an adapter, and a broker to call it with.
#pragma once

#include "cimserver/broker/broker.h"
#include "cimserver/broker/request.h"
#include "cimserver/model/values.h"
#include "cmpi/entry.h"
#include "tests/cmpi/test_providers.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

namespace test
{

inline constexpr const char* name_space = "root/zemlar";

cimserver::Value string(const char* text);
cimserver::Value reference(const char* class_name, const char* name); // to a thing, in another name space

// A result that keeps what it is given.
class Recorded_Result
{
public:
    Recorded_Result();
    Recorded_Result(const Recorded_Result&) = delete;
    Recorded_Result& operator=(const Recorded_Result&) = delete;
    const CMPIResult* face() const { return &_face; }
    void clear();

    std::vector<cimserver::Object_Path> paths;
    std::vector<cimserver::Value> data;
    std::vector<cimserver::Instance> instances;
    int done = 0;

private:
    CMPIResult _face;
};

// The adapter of a provider while it exists. Each test has a broker and a request around it, and no provider may be left
// over at its end.
class Served_Provider : public testing::Test
{
protected:
    void TearDown() override;

    // Factory calls: the interfaces of the providers.
    template <class MI> MI* interface(char kind, CMPI_Static_Data& sd, const Registration& registration)
    {
        void* mi = nullptr;
        cimple_cmpi_adapter('C', &sd, &registration, broker.face(), request.context(), registration.provider_name, kind, &mi);
        return static_cast<MI*>(mi);
    }
    CMPIInstanceMI* things() { return interface<CMPIInstanceMI>('I', thing_data, thing_registration); }
    CMPIInstanceMI* links() { return interface<CMPIInstanceMI>('I', link_data, link_registration); }
    CMPIAssociationMI* associations() { return interface<CMPIAssociationMI>('A', link_data, link_registration); }
    CMPIMethodMI* methods() { return interface<CMPIMethodMI>('M', disk_data, disk_registration); }
    CMPIIndicationMI* alerts() { return interface<CMPIIndicationMI>('N', alert_data, alert_registration); }

    // Objects of the broker, which the request owns.
    CMPIObjectPath* path(const char* class_name) const;
    CMPIObjectPath* thing_path(const char* name, const char* class_name = "TST_Thing") const;

    // The value of an item of a recorded path or instance; a failure when there is none.
    using Items = std::vector<cimserver::Named_Value>;
    static const cimserver::Value& value(const Items& items, const char* name);
    static std::string text(const Items& items, const char* name); // "(null)" for what is no text
    template <class T> static const T& content(const Items& items, const char* name) { return value(items, name).get<T>(); }
    static const cimserver::Object_Path& path_in(const Items& items, const char* name)
    {
        return content<cimserver::Object_Path>(items, name);
    }
    static std::string name_in(const cimserver::Object_Path& path) { return text(path.keys, "Name"); }
    static std::vector<std::string> names_of(const Items& items);

    // The names of the properties that have a value, or are asked for in a model.
    static std::vector<std::string> non_null_of(const Instance* instance);
    std::vector<std::string> asked_for() const { return non_null_of(script.model.ptr()); }

    // What the work logs at a level ("WARN"), as "source: message".
    static std::vector<std::string> logged(const std::function<void()>& work, const std::string& level = "WARN");

    Script& script = Script::fresh();
    const cimserver::Repository classes{&alert_registration};
    cimserver::Broker broker{classes};
    cimserver::Request request;
    CMPI_Static_Data thing_data = {};
    CMPI_Static_Data disk_data = {};
    CMPI_Static_Data link_data = {};
    CMPI_Static_Data alert_data = {};
};

} // namespace test
