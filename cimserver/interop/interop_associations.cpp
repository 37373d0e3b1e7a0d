// Association traversal in the interop name space: from an object of the server's own along the server's own associations,
// from any other along the module's.
#include "cimserver/interop/interop_operations.h"

#include "cimserver/association_routing.h"
#include "cimserver/key_conversion.h"
#include "cimserver/path_identity.h"

#include <algorithm>

namespace cimserver
{
namespace
{

using Reference = std::shared_ptr<const Object_Path>;

const Reference* reference_in(const Named_Value& property)
{
    const auto* reference = std::get_if<Reference>(&property.value.content);
    return reference && *reference ? reference : nullptr;
}

bool may_play(const Named_Value& property, const std::string& role) { return role.empty() || equal_names(property.name, role); }

// A reference without a name space is to an object of the association's.
std::string identity_of(Object_Path target)
{
    if (target.name_space.empty())
        target.name_space = Interop_Operations::name_space;
    return path_identity(target);
}

} // namespace

// A class of the filter may be the server's or the module's. One that the server's part does not have admits nothing there.
bool Interop_Operations::admits_own(const Association_Filter& filter) const
{
    bool all_own = true;
    for (const std::string* class_name : {&filter.association_class, &filter.result_class})
        if (!class_name->empty() && !_own.find(*class_name))
        {
            if (!_module_part.classes().find(*class_name))
                throw Cim_Error(CIM_ERR_INVALID_PARAMETER, "there is no class " + *class_name);
            all_own = false;
        }
    return all_own;
}

std::vector<Interop_Operations::Own_Reference>
Interop_Operations::own_references(const Object_Path& path, const Association_Filter& filter, Ends ends) const
{
    const Class_Entry& named = *_own.find(path.class_name);
    if (!admits_own(filter))
        return {};
    const std::string source = path_identity({"", name_space, named.meta_class->name, typed_keys(_own, named, path)});

    std::vector<Own_Reference> found;
    for (const Class_Entry* entry : concerned_associations(_classes, named, filter, ends))
        if (Server_Class* server_class = answering(*entry))
            for (Instance& association : server_class->enumerate())
                for (const Named_Value& property : association.properties)
                    if (const Reference* reference = reference_in(property);
                        reference && may_play(property, filter.role) && identity_of(**reference) == source)
                    {
                        std::string near = property.name;
                        found.push_back({*entry, std::move(association), std::move(near)});
                        break;
                    }
    return found;
}

std::vector<Object_Path> Interop_Operations::own_associators(const Object_Path& path, const Association_Filter& filter) const
{
    const Class_Entry* result_class = _own.find(filter.result_class);
    std::vector<Object_Path> paths;
    for (const Own_Reference& found : own_references(path, filter, Ends::both))
        for (const Named_Value& property : found.association.properties)
        {
            const Reference* reference = reference_in(property);
            if (!reference || property.name == found.near || !may_play(property, filter.result_role))
                continue;
            const Class_Entry* far = _own.find((*reference)->class_name);
            if (far && (!result_class || Repository::is_a(far->meta_class, result_class->meta_class)))
                paths.push_back(**reference);
        }
    remove_duplicates(paths);
    return paths;
}

// One that is deleted meanwhile is left out.
std::vector<Instance> Interop_Operations::associators(const Object_Path& path, const Association_Filter& filter,
                                                      const Property_List& properties)
{
    if (!is_own(path.class_name))
        return _module_part.associators(path, filter, properties);
    std::vector<Instance> instances;
    for (const Object_Path& target : own_associators(path, filter))
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

std::vector<Object_Path> Interop_Operations::associator_names(const Object_Path& path, const Association_Filter& filter)
{
    if (!is_own(path.class_name))
        return _module_part.associator_names(path, filter);
    return own_associators(path, filter);
}

std::vector<Instance> Interop_Operations::references(const Object_Path& path, const Association_Filter& filter,
                                                     const Property_List& properties)
{
    if (!is_own(path.class_name))
        return _module_part.references(path, filter, properties);
    std::vector<Instance> instances;
    for (Own_Reference& found : own_references(path, filter, Ends::source))
        instances.push_back(shown(std::move(found.association), found.entry, properties, nullptr));
    return instances;
}

std::vector<Object_Path> Interop_Operations::reference_names(const Object_Path& path, const Association_Filter& filter)
{
    if (!is_own(path.class_name))
        return _module_part.reference_names(path, filter);
    std::vector<Object_Path> paths;
    for (Own_Reference& found : own_references(path, filter, Ends::source))
    {
        paths.push_back(std::move(found.association.path));
        paths.back().name_space = name_space;
    }
    return paths;
}

} // namespace cimserver
