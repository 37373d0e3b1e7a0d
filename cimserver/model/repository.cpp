#include "cimserver/model/repository.h"

#include "cimserver/model/meta_search.h"

#include <algorithm>
#include <iterator>
#include <stdexcept>

namespace cimserver
{

Repository::Repository(const zmlr::Registration* head)
{
    for (const zmlr::Registration* record = head; record; record = record->next)
    {
        if (!record->provider_name || !record->meta_class || !record->meta_class->meta_repository)
            throw std::runtime_error("the module's registration list holds an incomplete record");
        if (_entries.empty())
        {
            const zmlr::Meta_Repository* repository = record->meta_class->meta_repository;
            for (zmlr::uint32 i = 0; i < repository->num_meta_classes; ++i)
                add(*repository->meta_classes[i]);
        }
        const auto found = _index.find(record->meta_class->name);
        if (found == _index.end())
            throw std::runtime_error(std::string("the module's repository lacks the served class ") + record->meta_class->name);
        found->second->registration = record;
        _served.push_back(found->second);
    }
    std::reverse(_served.begin(), _served.end());
    index_served();
}

void Repository::add(const zmlr::Meta_Class& meta_class)
{
    auto layout = std::make_shared<const Property_Layout>(meta_class);
    _entries.push_back(std::make_shared<Class_Entry>(Class_Entry{meta_class.name, &meta_class, std::move(layout), nullptr}));
    _index.emplace(meta_class.name, _entries.back().get());
}

Repository::Repository(const Repository& whole, std::span<const std::string_view> roots)
{
    for (const Class_Entry* entry : whole.served())
    {
        const zmlr::Meta_Class* ancestor = entry->meta_class;
        while (ancestor && !is_among(roots, ancestor->name))
            ancestor = ancestor->super_meta_class;
        if (!ancestor)
            continue;
        _served.push_back(entry);
        show(whole, entry->meta_class);
    }
    std::ranges::copy_if(whole._entries, std::back_inserter(_entries),
                         [&](const Entry& entry) { return find(entry->meta_class->name); });
    index_served();
}

void Repository::index_served()
{
    for (const Class_Entry* entry : _served)
        for (const zmlr::Meta_Class* meta_class = entry->meta_class; meta_class; meta_class = meta_class->super_meta_class)
            _served_by_class[meta_class].push_back(entry);
}

// A class that is shown already brought what belongs to it along.
void Repository::show(const Repository& whole, const zmlr::Meta_Class* meta_class)
{
    const auto entry = meta_class ? whole._index.find(meta_class->name) : whole._index.end();
    if (entry == whole._index.end() || !_index.insert(*entry).second)
        return;
    show(whole, meta_class->super_meta_class);
    for (const zmlr::Meta_Feature* feature : features_of(*meta_class))
        if (zmlr::is_reference(feature))
            show(whole, zmlr::as_reference(feature)->meta_class);
}

const Class_Entry* Repository::find(std::string_view class_name) const
{
    const auto found = _index.find(class_name);
    return found == _index.end() ? nullptr : found->second;
}

const Class_Entry& Repository::get(std::string_view class_name, int unknown) const
{
    if (const Class_Entry* entry = find(class_name))
        return *entry;
    throw Cim_Error(unknown, "there is no class " + std::string(class_name));
}

bool Repository::is_a(const zmlr::Meta_Class* meta_class, const zmlr::Meta_Class* ancestor)
{
    while (meta_class && meta_class != ancestor)
        meta_class = meta_class->super_meta_class;
    return meta_class != nullptr;
}

const std::vector<const Class_Entry*>& Repository::served(const Class_Entry& entry) const
{
    static const std::vector<const Class_Entry*> nobody;
    const auto found = _served_by_class.find(entry.meta_class);
    return found == _served_by_class.end() ? nobody : found->second;
}

// A class may derive from a root that is no CIM class and that the repository therefore does not list.
bool Repository::at_top(const zmlr::Meta_Class* meta_class) const
{
    return !meta_class->super_meta_class || !find(meta_class->super_meta_class->name);
}

std::vector<const zmlr::Meta_Class*> Repository::subclasses(const zmlr::Meta_Class* parent, bool deep) const
{
    const auto wanted = [&](const zmlr::Meta_Class* meta_class)
    {
        if (!parent)
            return deep || at_top(meta_class);
        return deep ? meta_class != parent && is_a(meta_class, parent) : meta_class->super_meta_class == parent;
    };

    std::vector<const zmlr::Meta_Class*> result;
    for (const auto& entry : _entries)
        if (wanted(entry->meta_class))
            result.push_back(entry->meta_class);
    return result;
}

bool are_related(const zmlr::Meta_Class* a, const zmlr::Meta_Class* b)
{
    return Repository::is_a(a, b) || Repository::is_a(b, a);
}

} // namespace cimserver
