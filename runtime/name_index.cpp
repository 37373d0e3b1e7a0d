#include "runtime/name_index.h"

#include "runtime/string.h"

namespace zmlr
{

namespace
{

// The entries from the first one of this hash on.
template <class Entry> std::span<const Entry> from_hash(std::span<const Entry> entries, uint32 hash)
{
    return {std::ranges::lower_bound(entries, hash, {}, &Entry::hash), entries.end()};
}

} // namespace

const Record_Entry* find_entry(const Meta_Record* record)
{
    const Repository_Index* index = &own_repository_index;
    if (!index)
        return nullptr;
    const uint32 hash = name_hash(record->name);
    for (const Record_Entry& entry : from_hash(is_method(record) ? index->methods : index->classes, hash))
    {
        if (entry.record == record)
            return &entry;
        if (entry.hash != hash)
            break;
    }
    return nullptr;
}

const Meta_Class* find_meta_class(const Repository_Index& index, const char* name)
{
    const auto found = from_hash(index.classes, name_hash(name));
    return !found.empty() && eqi(found.front().record->name, name) ? static_cast<const Meta_Class*>(found.front().record)
                                                                   : nullptr;
}

const Meta_Feature* find_feature(const Record_Entry& entry, const char* name)
{
    const auto found = from_hash(std::span(entry.features, entry.record->num_meta_features), name_hash(name));
    if (found.empty())
        return nullptr;
    const Meta_Feature* feature = entry.record->meta_features[found.front().position];
    return eqi(feature->name, name) ? feature : nullptr;
}

} // namespace zmlr
