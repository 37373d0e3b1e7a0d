#include "cimserver/model/meta_search.h"

#include "cimserver/model/names.h"

namespace cimserver
{

unsigned feature_index(const zmlr::Meta_Record& record, std::string_view name)
{
    for (unsigned i = 0; i < record.num_meta_features; ++i)
        if (equal_names(record.meta_features[i]->name, name))
            return i;
    return record.num_meta_features;
}

const zmlr::Meta_Feature* find_feature(const zmlr::Meta_Record& record, std::string_view name)
{
    const unsigned index = feature_index(record, name);
    return index < record.num_meta_features ? record.meta_features[index] : nullptr;
}

const zmlr::Meta_Feature* find_value(const zmlr::Meta_Record& record, std::string_view name)
{
    const zmlr::Meta_Feature* feature = find_feature(record, name);
    return feature && !zmlr::is_method(feature) ? feature : nullptr;
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
