#include "cimserver/broker/repository.h"

#include <algorithm>
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
                add(repository->meta_classes[i]);
        }
        const auto found = _index.find(record->meta_class->name);
        if (found == _index.end())
            throw std::runtime_error(std::string("the module's repository lacks the served class ") + record->meta_class->name);
        found->second->registration = record;
        _served.push_back(found->second);
    }
    std::reverse(_served.begin(), _served.end());
}

void Repository::add(const zmlr::Meta_Class* meta_class)
{
    _entries.push_back(
        std::make_unique<Class_Entry>(Class_Entry{meta_class, std::make_shared<const Property_Layout>(*meta_class), nullptr}));
    _index.emplace(meta_class->name, _entries.back().get());
}

const Class_Entry* Repository::find(std::string_view class_name) const
{
    const auto found = _index.find(class_name);
    return found == _index.end() ? nullptr : found->second;
}

bool Repository::is_a(const zmlr::Meta_Class* meta_class, const zmlr::Meta_Class* ancestor)
{
    while (meta_class && meta_class != ancestor)
        meta_class = meta_class->super_meta_class;
    return meta_class != nullptr;
}

std::vector<const Class_Entry*> Repository::served(const Class_Entry& entry) const
{
    std::vector<const Class_Entry*> result;
    for (const Class_Entry* candidate : _served)
        if (is_a(candidate->meta_class, entry.meta_class))
            result.push_back(candidate);
    return result;
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

} // namespace cimserver
