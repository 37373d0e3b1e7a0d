#include "tests/cmpi/served_provider.h"

#include "cimserver/broker/cmpi_values.h"
#include "cimserver/broker/objects.h"
#include "tests/runtime/home.h"

#include <cmpimacs.h>

#include <cstdlib>

namespace test
{

namespace
{

Recorded_Result& recorder(const CMPIResult* result) { return *static_cast<Recorded_Result*>(result->hdl); }

CMPIStatus return_instance(const CMPIResult* result, const CMPIInstance* instance)
{
    recorder(result).instances.push_back(cimserver::object<cimserver::Instance_Object>(instance).model());
    return {CMPI_RC_OK, nullptr};
}

CMPIStatus return_data(const CMPIResult* result, const CMPIValue* value, CMPIType type)
{
    recorder(result).data.push_back(cimserver::from_cmpi(value, type));
    return {CMPI_RC_OK, nullptr};
}

CMPIStatus return_path(const CMPIResult* result, const CMPIObjectPath* path)
{
    recorder(result).paths.push_back(cimserver::object<cimserver::Path_Object>(path).path);
    return {CMPI_RC_OK, nullptr};
}

CMPIStatus return_done(const CMPIResult* result)
{
    ++recorder(result).done;
    return {CMPI_RC_OK, nullptr};
}

// The tests' home, where everything is logged. The option file is read on the first log call of the process.
class Logging_Home : public testing::Environment
{
public:
    void SetUp() override
    {
        home.options("LOG_LEVEL = DBG\n");
        setenv("HOME", home.path("").c_str(), 1);
    }

    const sample::Home home{};
};

Logging_Home& logging_home = *static_cast<Logging_Home*>(testing::AddGlobalTestEnvironment(new Logging_Home));

CMPIResultFT result_table = {100, nullptr, nullptr, return_data, return_instance, return_path, return_done};

} // namespace

cimserver::Value string(const char* text) { return {CMPI_string, std::string(text)}; }

cimserver::Value reference(const char* class_name, const char* name)
{
    const cimserver::Object_Path path = {"host", "root/elsewhere", class_name, {{"Name", string(name)}}};
    return {CMPI_ref, path};
}

Recorded_Result::Recorded_Result() : _face{this, &result_table} {}

void Recorded_Result::clear()
{
    paths.clear();
    data.clear();
    instances.clear();
    done = 0;
}

void Served_Provider::TearDown()
{
    for (CMPI_Static_Data* sd : {&thing_data, &disk_data, &link_data, &alert_data})
        delete sd->adapter;
    EXPECT_EQ(script.providers, 0);
    Script::fresh();
}

CMPIObjectPath* Served_Provider::path(const char* class_name) const
{
    return CMNewObjectPath(broker.face(), name_space, class_name, nullptr);
}

CMPIObjectPath* Served_Provider::thing_path(const char* name, const char* class_name) const
{
    CMPIObjectPath* result = path(class_name);
    CMAddKey(result, "name", name, CMPI_chars);
    return result;
}

const cimserver::Value& Served_Provider::value(const Items& items, const char* name)
{
    for (const auto& item : items)
    {
        if (eqi(item.name.string().c_str(), name))
            return item.value;
    }
    ADD_FAILURE() << "no item " << name;
    static const cimserver::Value none;
    return none;
}

std::string Served_Provider::text(const Items& items, const char* name)
{
    const auto* content = value(items, name).as<cimserver::Text>();
    return content ? *content : "(null)";
}

std::vector<std::string> Served_Provider::names_of(const Items& items)
{
    std::vector<std::string> names;
    for (const auto& item : items)
        names.push_back(item.name);
    return names;
}

std::vector<std::string> Served_Provider::non_null_of(const Instance* instance)
{
    std::vector<std::string> names;
    for (uint32 i = 0; i < instance->meta_class->num_meta_features; ++i)
    {
        const Meta_Feature* feature = instance->meta_class->meta_features[i];
        if (is_property(feature) && !null_of(instance, as_property(feature)))
            names.emplace_back(feature->name);
    }
    return names;
}

std::vector<std::string> Served_Provider::logged(const std::function<void()>& work, const std::string& level)
{
    const std::size_t before = logging_home.home.lines().size();
    work();
    std::vector<std::string> messages;
    const auto lines = logging_home.home.lines();
    for (auto line = lines.begin() + static_cast<std::ptrdiff_t>(before); line != lines.end(); ++line)
    {
        const auto source = line->find(level + ": "); // "time LEVEL: source(line): message"
        if (source == std::string::npos)
            continue;
        const auto begin = source + level.size() + 2;
        messages.push_back(line->substr(begin, line->find('(') - begin) + line->substr(line->find("): ") + 1));
    }
    return messages;
}

} // namespace test
