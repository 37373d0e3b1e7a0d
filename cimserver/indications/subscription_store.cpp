#include "cimserver/indications/subscription_store.h"

#include "cimserver/interop/server_schema.h"
#include "cimserver/model/cim_types.h"

#include <nlohmann/json.hpp>

#include <unistd.h>

#include <cerrno>
#include <stdexcept>

namespace cimserver
{
namespace
{

using Json = nlohmann::json;

constexpr std::size_t max_file_bytes = std::size_t{64} << 20;
constexpr int file_version = 1;
constexpr const char* damaged = " is damaged: ";
constexpr const char* remedy = " (move it away to start without subscriptions)";
constexpr int max_depth = 8; // a subscription's reference has its keys at 5

struct List
{
    const char* name;
    const zmlr::Meta_Class* meta_class;
};

constexpr List lists[] = {
    {"filters", &CIM_IndicationFilter},
    {"destinations", &CIM_ListenerDestinationCIMXML},
    {"subscriptions", &CIM_IndicationSubscription},
};

Json json_of(const Value& value);

Json json_of(const std::vector<Named_Value>& values)
{
    Json json = Json::object();
    for (const auto& [name, value] : values)
        if (!value.null())
            json[name.string()] = json_of(value);
    return json;
}

Json json_of(std::monostate) { return nullptr; }
Json json_of(const Instance&) { return nullptr; } // no property of these classes holds one

Json json_of(const Object_Path& path)
{
    return {{"class", path.class_name.string()}, {"name space", path.name_space}, {"keys", json_of(path.keys)}};
}

Json json_of(const std::vector<Value>& elements)
{
    Json list = Json::array();
    for (const Value& element : elements)
        list.push_back(json_of(element));
    return list;
}

template <class T> Json json_of(const T& scalar) { return scalar; }
template <class T> Json json_of(const Shared<T>& content) { return json_of(*content); }

Json json_of(const Value& value)
{
    return std::visit([](const auto& content) { return json_of(content); }, value.content);
}

// What a damaged file makes throw is read before an aggregate is begun: g++ 12 destroys the members of an unfinished one twice.
Value value_of(const Json& json);

std::vector<Named_Value> values_of(const Json& json)
{
    std::vector<Named_Value> values;
    for (const auto& [name, value] : json.get_ref<const Json::object_t&>())
    {
        Value read = value_of(value);
        values.push_back({name, std::move(read)});
    }
    return values;
}

Value value_of(const Json& json)
{
    if (json.is_string())
        return {CMPI_string, json.get<std::string>()};
    if (json.is_boolean())
        return {CMPI_boolean, json.get<bool>()};
    if (json.is_number())
        return {CMPI_string, json.dump()};
    if (json.is_array())
    {
        std::vector<Value> elements;
        for (const Json& element : json)
            elements.push_back(value_of(element));
        return {array_of(CMPI_string), std::move(elements)};
    }
    Object_Path path;
    path.name_space = json.at("name space");
    path.class_name = json.at("class").get<std::string>();
    path.keys = values_of(json.at("keys"));
    return {CMPI_ref, std::move(path)};
}

// Readers of values call themselves.
bool refuse_deep(int depth, Json::parse_event_t, const Json&)
{
    if (depth > max_depth)
        throw std::runtime_error("it is nested too deeply");
    return true;
}

Stored_Instances instances_of(const Json& json)
{
    if (json.at("version") != file_version)
        throw std::runtime_error("it is of another version");
    Stored_Instances stored;
    for (std::size_t kind = 0; kind < std::size(lists); ++kind)
        for (const Json& instance : json.at(lists[kind].name).get_ref<const Json::array_t&>())
        {
            stored[kind].emplace_back().path.class_name = lists[kind].meta_class->name;
            stored[kind].back().properties = values_of(instance);
        }
    return stored;
}

std::string made_folder(const std::string& folder)
{
    make_private_folder(folder, File_Privacy::owner_only);
    return folder;
}

} // namespace

const zmlr::Meta_Class& class_of(Subscription_Kind kind) { return *lists[static_cast<std::size_t>(kind)].meta_class; }

Subscription_Store::Subscription_Store(const std::string& folder)
    : _lock(made_folder(folder), Folder_Lock::Wait::no)
    , _file(folder + "/subscriptions.json")
{
    remove_unfinished_writes(_file);
}

Stored_Instances Subscription_Store::load() const
{
    if (access(_file.c_str(), F_OK) != 0 && errno == ENOENT)
        return {};
    const std::string text = read_private_file(_file, max_file_bytes);
    try
    {
        return instances_of(Json::parse(text, refuse_deep));
    }
    catch (const Json::exception&)
    {
        throw std::runtime_error(_file + damaged + "it is not what this server writes" + remedy);
    }
    catch (const std::runtime_error& error)
    {
        throw std::runtime_error(_file + damaged + error.what() + remedy);
    }
}

// Texts are what a client sent, valid UTF-8 or not.
void Subscription_Store::save(const Stored_Instances& instances) const
{
    Json json = {{"version", file_version}};
    for (std::size_t kind = 0; kind < std::size(lists); ++kind)
    {
        Json& list = json[lists[kind].name] = Json::array();
        for (const Instance& instance : instances[kind])
            list.push_back(json_of(std::vector<Named_Value>(instance.properties)));
    }
    write_private_file(_file, json.dump(2, ' ', false, Json::error_handler_t::replace) + "\n");
}

} // namespace cimserver
