#include "cimserver/interop/own_operations.h"

#include "cimserver/interop/server_schema.h"
#include "cimserver/model/paths.h"
#include "cimserver/operations/typed_keys.h"
#include "cimserver/operations/typed_objects.h"

#include <algorithm>
#include <stdexcept>

namespace cimserver
{
namespace
{

// References under another name of this name space are to the same objects.
void use_one_name(std::vector<Named_Value>& values)
{
    for (Named_Value& value : values)
        if (const auto* reference = value.value.as<Object_Path>(); reference && Own_Operations::is_name(reference->name_space))
        {
            Object_Path path = *reference;
            path.name_space = Own_Operations::name_space;
            value.value.content = std::move(path);
        }
}

std::optional<Instance> find_instance(const Server_Class& server_class, const Object_Path& path)
{
    const std::string wanted = path_identity(path);
    for (Instance& instance : server_class.enumerate())
    {
        instance.path.name_space = path.name_space;
        if (path_identity(instance.path) == wanted)
            return std::move(instance);
    }
    return std::nullopt;
}

} // namespace

bool Own_Operations::is_name(std::string_view name) { return is_among(names, name); }

std::vector<Named_Value> Own_Operations::keys_of(const Class_Entry& entry, const Object_Path& path) const
{
    std::vector<Named_Value> keys = typed_keys(_repository, entry, path);
    use_one_name(keys);
    return keys;
}

Own_Operations::Own_Operations(const Repository& module_classes)
    : _module_classes(module_classes)
    , _repository(server_registrations())
{
}

void Own_Operations::serve(Server_Class server_class)
{
    const Class_Entry* entry = _repository.find(server_class.meta_class.name);
    if (!entry || entry->meta_class != &server_class.meta_class || _server_classes.contains(entry))
        throw std::logic_error(std::string("the server cannot answer class ") + server_class.meta_class.name);
    _server_classes.emplace(entry, std::move(server_class));
}

const Server_Class* Own_Operations::answering(const Class_Entry& entry) const
{
    const auto found = _server_classes.find(&entry);
    return found == _server_classes.end() ? nullptr : &found->second;
}

// A path may name a superclass of the instance's.
Own_Operations::Found Own_Operations::find(const Object_Path& path) const
{
    for (const Class_Entry* entry : _repository.served(_repository.get(path.class_name)))
        if (const Server_Class* server_class = answering(*entry))
        {
            Object_Path own_path{{}, name_space, entry->name, keys_of(*entry, path)};
            if (auto instance = find_instance(*server_class, own_path))
                return {*entry, *server_class, std::move(own_path), *std::move(instance)};
        }
    throw Cim_Error(CIM_ERR_NOT_FOUND, "there is no such instance of class " + path.class_name.string());
}

Instance Own_Operations::shown(Instance instance, const Class_Entry& entry, const Property_List& properties)
{
    std::vector<Named_Value> all;
    for (const std::string& name : entry.layout->names(properties))
    {
        const Value* found = instance.properties.find(name);
        all.push_back({name, found ? *found : (*entry.layout)[*entry.layout->find(name)].value});
    }
    instance.properties = std::move(all);
    instance.path.name_space = name_space;
    return instance;
}

const zmlr::Meta_Class* Own_Operations::get_class(const std::string& class_name)
{
    return _repository.get(class_name).meta_class;
}

std::vector<const zmlr::Meta_Class*> Own_Operations::enumerate_classes(const std::string& class_name, bool deep_inheritance)
{
    return _repository.subclasses(class_name.empty() ? nullptr : _repository.get(class_name).meta_class, deep_inheritance);
}

std::vector<Object_Path> Own_Operations::enumerate_instance_names(const std::string& class_name)
{
    std::vector<Object_Path> paths;
    for (Instance& instance : enumerate_instances(class_name, true, std::vector<std::string>()))
        paths.push_back(std::move(instance.path));
    return paths;
}

std::vector<Instance> Own_Operations::enumerate_instances(const std::string& class_name, bool deep_inheritance,
                                                          const Property_List& properties)
{
    const Class_Entry& named = _repository.get(class_name);
    const Property_List asked = deep_inheritance ? properties : named.layout->names(properties);
    std::vector<Instance> instances;
    for (const Class_Entry* entry : _repository.served(named))
        if (const Server_Class* server_class = answering(*entry))
            for (Instance& instance : server_class->enumerate())
                instances.push_back(shown(std::move(instance), *entry, asked));
    return instances;
}

Instance Own_Operations::get_instance(const Object_Path& path, const Property_List& properties)
{
    Found found = find(path);
    return shown(std::move(found.instance), found.entry, properties);
}

Object_Path Own_Operations::create_instance(const Instance& instance)
{
    const Class_Entry& entry = _repository.get(instance.path.class_name);
    const Server_Class* server_class = answering(entry);
    if (!server_class || !server_class->create)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("instances of ") + entry.meta_class->name + " cannot be created");

    Instance asked = instance;
    asked.path.name_space = name_space;
    asked = typed_instance(_repository, entry, asked, CIM_ERR_INVALID_PARAMETER);
    use_one_name(asked.path.keys);
    Object_Path path = server_class->create(asked);
    path.name_space = name_space;
    return path;
}

void Own_Operations::modify_instance(const Instance& instance, const Property_List&)
{
    const Found found = find(instance.path);
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("instances of ") + found.entry.meta_class->name + " cannot be modified");
}

void Own_Operations::delete_instance(const Object_Path& path)
{
    const Found found = find(path);
    if (!found.server_class.remove)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED,
                        std::string("instances of ") + found.entry.meta_class->name + " cannot be deleted");
    found.server_class.remove(found.path);
}

Method_Result Own_Operations::invoke_method(const Object_Path& path, const std::string& method, const std::vector<Named_Value>&)
{
    throw Cim_Error(CIM_ERR_METHOD_NOT_FOUND, "class " + path.class_name.string() + " has no method " + method);
}

} // namespace cimserver
