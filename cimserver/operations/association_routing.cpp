#include "cimserver/operations/association_routing.h"

#include "cimserver/model/meta_search.h"

#include <algorithm>

namespace cimserver
{
namespace
{

using References = std::vector<const zmlr::Meta_Reference*>;

References references_of(const zmlr::Meta_Class& meta_class)
{
    References result;
    for (const zmlr::Meta_Feature* feature : features_of(meta_class))
        if (zmlr::is_reference(feature))
            result.push_back(zmlr::as_reference(feature));
    return result;
}

// A class that a filter names, null when it names none.
const zmlr::Meta_Class* named(const Repository& known, const std::string& class_name)
{
    return class_name.empty() ? nullptr : known.get(class_name, CIM_ERR_INVALID_PARAMETER).meta_class;
}

bool can_name(const zmlr::Meta_Reference& reference, const zmlr::Meta_Class* meta_class, const std::string& role)
{
    return (!meta_class || are_related(reference.meta_class, meta_class)) && (role.empty() || equal_names(reference.name, role));
}

} // namespace

std::vector<const Class_Entry*> concerned_associations(const Repository& classes, const Repository& known,
                                                       const Class_Entry& source, const Association_Filter& filter, Ends ends)
{
    const zmlr::Meta_Class* wanted = named(known, filter.association_class);
    const zmlr::Meta_Class* result_class = ends == Ends::both ? named(known, filter.result_class) : nullptr;

    const auto concerns = [&](const References& references, const zmlr::Meta_Reference* near)
    {
        if (!can_name(*near, source.meta_class, filter.role))
            return false;
        return ends == Ends::source ||
               std::ranges::any_of(references, [&](const zmlr::Meta_Reference* far)
                                   { return far != near && can_name(*far, result_class, filter.result_role); });
    };
    const auto is_concerned = [&](const Class_Entry* entry)
    {
        if ((entry->meta_class->flags & zmlr::Flag_Association) == 0 || (wanted && !Repository::is_a(entry->meta_class, wanted)))
            return false;
        const References references = references_of(*entry->meta_class);
        return std::ranges::any_of(references, [&](const zmlr::Meta_Reference* near) { return concerns(references, near); });
    };

    std::vector<const Class_Entry*> result;
    std::ranges::copy_if(classes.served(), std::back_inserter(result), is_concerned);
    return result;
}

} // namespace cimserver
