#include "runtime/name_index.h"

#include "runtime/string.h"

namespace zmlr
{

namespace
{

template <class Entry> std::span<const Entry> with_hash(std::span<const Entry> entries, uint32 hash)
{
    return {std::ranges::lower_bound(entries, hash, {}, &Entry::hash), std::ranges::upper_bound(entries, hash, {}, &Entry::hash)};
}

} // namespace

const Record_Entry* find_entry(const Meta_Record* record)
{
    const Repository_Index* index = &own_repository_index;
    if (!index)
        return nullptr;
    for (const Record_Entry& entry : with_hash(is_method(record) ? index->methods : index->classes, name_hash(record->name)))
        if (entry.record == record)
            return &entry;
    return nullptr;
}

const Meta_Class* find_meta_class(const Repository_Index& index, const char* name)
{
    for (const Record_Entry& entry : with_hash(index.classes, name_hash(name)))
        if (eqi(entry.record->name, name))
            return static_cast<const Meta_Class*>(entry.record);
    return nullptr;
}

const Meta_Feature* find_feature(const Record_Entry& entry, const char* name)
{
    const std::span entries(entry.features, entry.record->num_meta_features);
    for (const Feature_Entry& candidate : with_hash(entries, name_hash(name)))
    {
        const Meta_Feature* feature = entry.record->meta_features[candidate.position];
        if (eqi(feature->name, name))
            return feature;
    }
    return nullptr;
}

} // namespace zmlr
