// Association traversal from an object of the server's own along the server's own associations.
#include "cimserver/interop/own_operations.h"

#include "cimserver/model/paths.h"
#include "cimserver/operations/association_routing.h"
#include "cimserver/operations/typed_keys.h"

namespace cimserver
{
namespace
{

bool may_play(std::string_view end, const std::string& role) { return role.empty() || equal_names(end, role); }

// A reference without a name space is to an object of the association's.
std::string identity_of(Object_Path target)
{
    if (target.name_space.empty())
        target.name_space = Own_Operations::name_space;
    return path_identity(target);
}

} // namespace

// A class of the filter may be the server's or the module's. One that the server's part does not have admits nothing there.
bool Own_Operations::admits(const Association_Filter& filter) const
{
    bool all_own = true;
    for (const std::string* class_name : {&filter.association_class, &filter.result_class})
        if (!class_name->empty() && !_repository.find(*class_name))
        {
            _module_classes.get(*class_name, CIM_ERR_INVALID_PARAMETER);
            all_own = false;
        }
    return all_own;
}

std::vector<Own_Operations::Reference> Own_Operations::find_references(const Object_Path& path, const Association_Filter& filter,
                                                                       Ends ends) const
{
    const Class_Entry& named = *_repository.find(path.class_name);
    if (!admits(filter))
        return {};
    const std::string source = path_identity({{}, name_space, named.name, keys_of(named, path)});

    std::vector<Reference> found;
    for (const Class_Entry* entry : concerned_associations(_repository, _repository, named, filter, ends))
        if (const Server_Class* server_class = answering(*entry))
            for (Instance& association : server_class->enumerate())
                for (const auto& property : association.properties)
                    if (const auto* reference = property.value.as<Object_Path>();
                        reference && may_play(property.name, filter.role) && identity_of(*reference) == source)
                    {
                        std::string near = property.name;
                        found.push_back({*entry, std::move(association), std::move(near)});
                        break;
                    }
    return found;
}

std::vector<Object_Path> Own_Operations::associator_names(const Object_Path& path, const Association_Filter& filter)
{
    const Class_Entry* result_class = _repository.find(filter.result_class);
    std::vector<Object_Path> paths;
    for (const Reference& found : find_references(path, filter, Ends::both))
        for (const auto& property : found.association.properties)
        {
            const auto* reference = property.value.as<Object_Path>();
            if (!reference || property.name == found.near || !may_play(property.name, filter.result_role))
                continue;
            const Class_Entry* far = _repository.find(reference->class_name);
            if (far && (!result_class || Repository::is_a(far->meta_class, result_class->meta_class)))
                paths.push_back(*reference);
        }
    remove_duplicates(paths);
    return paths;
}

// One that is deleted meanwhile is left out.
std::vector<Instance> Own_Operations::associators(const Object_Path& path, const Association_Filter& filter,
                                                  const Property_List& properties)
{
    std::vector<Instance> instances;
    for (const Object_Path& target : associator_names(path, filter))
        try
        {
            instances.push_back(get_instance(target, properties));
        }
        catch (const Cim_Error& error)
        {
            if (error.code() != CIM_ERR_NOT_FOUND)
                throw;
        }
    return instances;
}

std::vector<Instance> Own_Operations::references(const Object_Path& path, const Association_Filter& filter,
                                                 const Property_List& properties)
{
    std::vector<Instance> instances;
    for (Reference& found : find_references(path, filter, Ends::source))
        instances.push_back(shown(std::move(found.association), found.entry, properties));
    return instances;
}

std::vector<Object_Path> Own_Operations::reference_names(const Object_Path& path, const Association_Filter& filter)
{
    std::vector<Object_Path> paths;
    for (Reference& found : find_references(path, filter, Ends::source))
    {
        paths.push_back(std::move(found.association.path));
        paths.back().name_space = name_space;
    }
    return paths;
}

} // namespace cimserver
