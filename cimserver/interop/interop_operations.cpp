#include "cimserver/interop/interop_operations.h"

#include "cimserver/interop/server_schema.h"
#include "cimserver/key_conversion.h"
#include "cimserver/object_conversion.h"

#include <algorithm>
#include <stdexcept>

namespace cimserver
{
namespace
{

// What clients look for in the interop name space besides the server itself: the profiles, what conforms to them, and the
// software that implements them.
constexpr std::string_view module_roots[] = {
    "CIM_RegisteredProfile", "CIM_ElementConformsToProfile",   "CIM_SubProfileRequiresProfile",
    "CIM_ReferencedProfile", "ZEMLAR_ProfileSoftwareIdentity", "ZEMLAR_ProfileElementSoftwareIdentity",
};

std::vector<Object_Path> paths_of(const std::vector<Instance>& instances)
{
    std::vector<Object_Path> paths;
    std::ranges::transform(instances, std::back_inserter(paths), &Instance::path);
    return paths;
}

template <class T> void append(std::vector<T>& to, std::vector<T> from)
{
    to.insert(to.end(), std::make_move_iterator(from.begin()), std::make_move_iterator(from.end()));
}

} // namespace

Interop_Operations::Interop_Operations(Module& module)
    : _own(server_registrations())
    , _classes(_own)
    , _module_part(module, name_space, module_roots)
{
}

Instance Interop_Operations::shown(Instance instance, const Class_Entry& entry, const Property_List& properties,
                                   const Property_Layout* named_class)
{
    const std::vector<bool> selected =
        properties ? entry.layout->select(*properties) : std::vector<bool>(entry.layout->size(), true);
    std::vector<Named_Value> all;
    for (std::size_t slot = 0; slot < entry.layout->size(); ++slot)
    {
        const auto& [name, type, key] = entry.layout->slots()[slot];
        if (!selected[slot] || (named_class && !named_class->find(name)))
            continue;
        Named_Value* found = find_named(instance.properties, name);
        all.push_back({name, found ? std::move(found->value) : Value{type, {}}});
    }
    instance.properties = std::move(all);
    instance.path.name_space = name_space;
    return instance;
}

void Interop_Operations::serve(std::unique_ptr<Server_Class> server_class)
{
    const Class_Entry* entry = _own.find(server_class->meta_class().name);
    if (!entry || entry->meta_class != &server_class->meta_class() || _server_classes.contains(entry))
        throw std::logic_error(std::string("the server cannot answer class ") + server_class->meta_class().name);
    _server_classes.emplace(entry, std::move(server_class));
}

Server_Class* Interop_Operations::answering(const Class_Entry& entry) const
{
    const auto found = _server_classes.find(&entry);
    return found == _server_classes.end() ? nullptr : found->second.get();
}

Server_Class& Interop_Operations::changing(const Class_Entry& entry) const
{
    Server_Class* server_class = answering(entry);
    if (!server_class)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("nobody serves class ") + entry.meta_class->name);
    return *server_class;
}

const zmlr::Meta_Class* Interop_Operations::get_class(const std::string& asked, const std::string& class_name)
{
    const Class_Entry* own = _own.find(class_name);
    return own ? own->meta_class : _module_part.get_class(asked, class_name);
}

// The two trees meet in classes that both have, such as CIM_ManagedElement.
std::vector<const zmlr::Meta_Class*> Interop_Operations::enumerate_classes(const std::string& asked,
                                                                           const std::string& class_name, bool deep_inheritance)
{
    const Class_Entry* own = _own.find(class_name);
    const bool whole_tree = class_name.empty();
    std::vector<const zmlr::Meta_Class*> classes;
    if (own || whole_tree)
        classes = _own.subclasses(own ? own->meta_class : nullptr, deep_inheritance);
    if (!own || _module_part.classes().find(class_name))
        for (const zmlr::Meta_Class* meta_class : _module_part.enumerate_classes(asked, class_name, deep_inheritance))
            if (!_own.find(meta_class->name))
                classes.push_back(meta_class);
    return classes;
}

std::vector<Instance> Interop_Operations::own_instances(const Class_Entry& named, const Property_List& properties,
                                                        const Property_Layout* shown_class) const
{
    std::vector<Instance> instances;
    for (const Class_Entry* entry : _own.served(named))
        if (Server_Class* server_class = answering(*entry))
            for (Instance& instance : server_class->enumerate())
                instances.push_back(shown(std::move(instance), *entry, properties, shown_class));
    return instances;
}

std::vector<Object_Path> Interop_Operations::enumerate_instance_names(const std::string& asked, const std::string& class_name)
{
    const Class_Entry* own = _own.find(class_name);
    std::vector<Object_Path> paths;
    if (own)
        paths = paths_of(own_instances(*own, std::vector<std::string>(), nullptr));
    if (!own || _module_part.classes().find(class_name))
        append(paths, _module_part.enumerate_instance_names(asked, class_name));
    return paths;
}

std::vector<Instance> Interop_Operations::enumerate_instances(const std::string& asked, const std::string& class_name,
                                                              bool deep_inheritance, const Property_List& properties)
{
    const Class_Entry* own = _own.find(class_name);
    std::vector<Instance> instances;
    if (own)
        instances = own_instances(*own, properties, deep_inheritance ? nullptr : own->layout.get());
    if (!own || _module_part.classes().find(class_name))
        append(instances, _module_part.enumerate_instances(asked, class_name, deep_inheritance, properties));
    return instances;
}

// A path may name a superclass of the instance's; a class without keys has no instance of its own to name.
Interop_Operations::Found Interop_Operations::find_own(const Class_Entry& named, const Object_Path& path) const
{
    for (const Class_Entry* entry : _own.served(named))
        if (Server_Class* server_class = answering(*entry))
        {
            Object_Path own_path{"", name_space, entry->meta_class->name, typed_keys(_own, *entry, path)};
            if (auto instance = server_class->get(own_path))
                return {*entry, *server_class, std::move(own_path), *std::move(instance)};
        }
    throw Cim_Error(CIM_ERR_NOT_FOUND, "there is no such instance of class " + std::string(named.meta_class->name));
}

bool Interop_Operations::is_own(const std::string& class_name) const
{
    const Class_Entry* own = _own.find(class_name);
    return own && own->meta_class->num_keys > 0;
}

Instance Interop_Operations::get_instance(const Object_Path& path, const Property_List& properties)
{
    if (!is_own(path.class_name))
        return _module_part.get_instance(path, properties);
    Found found = find_own(*_own.find(path.class_name), path);
    return shown(std::move(found.instance), found.entry, properties, nullptr);
}

Object_Path Interop_Operations::create_instance(const Instance& instance)
{
    const Class_Entry* own = _own.find(instance.path.class_name);
    if (!own)
        return _module_part.create_instance(instance);
    Instance asked = instance;
    asked.path.name_space = name_space;
    Object_Path path = changing(*own).create(typed_instance(_own, *own, asked, CIM_ERR_INVALID_PARAMETER));
    path.name_space = name_space;
    return path;
}

void Interop_Operations::modify_instance(const Instance& instance, const Property_List& properties)
{
    if (!is_own(instance.path.class_name))
        return _module_part.modify_instance(instance, properties);
    const Found found = find_own(*_own.find(instance.path.class_name), instance.path);
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("instances of ") + found.entry.meta_class->name + " cannot be modified");
}

void Interop_Operations::delete_instance(const Object_Path& path)
{
    if (!is_own(path.class_name))
        return _module_part.delete_instance(path);
    const Found found = find_own(*_own.find(path.class_name), path);
    found.server_class.remove(found.path);
}

std::vector<Instance> Interop_Operations::exec_query(const std::string& asked, const std::string& query,
                                                     const std::string& language)
{
    if (const Class_Entry* own = _own.find(class_of_query(query)))
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("the server answers no queries of class ") + own->meta_class->name);
    return _module_part.exec_query(asked, query, language);
}

Method_Result Interop_Operations::invoke_method(const Object_Path& path, const std::string& method,
                                                const std::vector<Named_Value>& in)
{
    if (_own.find(path.class_name))
        throw Cim_Error(CIM_ERR_METHOD_NOT_FOUND, "class " + path.class_name + " has no method " + method);
    return _module_part.invoke_method(path, method, in);
}

} // namespace cimserver
