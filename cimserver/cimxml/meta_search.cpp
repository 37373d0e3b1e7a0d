#include "cimserver/cimxml/meta_search.h"

#include "cimserver/broker/names.h"

namespace cimserver
{

unsigned feature_index(const zmlr::Meta_Class& meta_class, std::string_view name)
{
    for (unsigned i = 0; i < meta_class.num_meta_features; ++i)
        if (equal_names(meta_class.meta_features[i]->name, name))
            return i;
    return meta_class.num_meta_features;
}

const zmlr::Meta_Class* describing_class_of(const zmlr::Meta_Class& meta_class, std::string_view feature)
{
    for (const zmlr::Meta_Class* ancestor = &meta_class; ancestor; ancestor = ancestor->super_meta_class)
    {
        const unsigned index = feature_index(*ancestor, feature);
        if (index == ancestor->num_meta_features)
            return nullptr;
        if (is_local(*ancestor, index))
            return ancestor;
    }
    return nullptr;
}

const zmlr::Meta_Class* origin_of(const zmlr::Meta_Class& meta_class, std::string_view feature)
{
    const zmlr::Meta_Class* origin = nullptr;
    for (const zmlr::Meta_Class* ancestor = &meta_class; ancestor; ancestor = ancestor->super_meta_class)
        if (feature_index(*ancestor, feature) < ancestor->num_meta_features)
            origin = ancestor;
    return origin;
}

} // namespace cimserver
