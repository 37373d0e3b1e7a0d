#include "cimserver/class_view.h"

#include <algorithm>

namespace cimserver
{
namespace
{

bool descends(const zmlr::Meta_Class* meta_class, std::span<const std::string_view> roots)
{
    for (; meta_class; meta_class = meta_class->super_meta_class)
        if (std::ranges::any_of(roots, [&](std::string_view root) { return equal_names(root, meta_class->name); }))
            return true;
    return false;
}

} // namespace

Class_View::Class_View(const Repository& repository) : _repository(repository), _all(true), _served(repository.served()) {}

Class_View::Class_View(const Repository& repository, std::span<const std::string_view> roots)
    : _repository(repository)
    , _all(false)
{
    for (const Class_Entry* entry : repository.served())
        if (descends(entry->meta_class, roots))
        {
            _served.push_back(entry);
            show(entry->meta_class);
        }
}

// A class that is shown already brought what belongs to it along.
void Class_View::show(const zmlr::Meta_Class* meta_class)
{
    if (!meta_class || !_shown.insert(meta_class).second)
        return;
    show(meta_class->super_meta_class);
    for (unsigned i = 0; i < meta_class->num_meta_features; ++i)
        if (const zmlr::Meta_Feature* feature = meta_class->meta_features[i]; zmlr::is_reference(feature))
            show(zmlr::as_reference(feature)->meta_class);
}

const Class_Entry* Class_View::find(std::string_view class_name) const
{
    const Class_Entry* entry = _repository.find(class_name);
    return entry && shows(entry->meta_class) ? entry : nullptr;
}

std::vector<const Class_Entry*> Class_View::served() const { return _served; }

std::vector<const Class_Entry*> Class_View::served(const Class_Entry& entry) const
{
    std::vector<const Class_Entry*> result;
    std::ranges::copy_if(_served, std::back_inserter(result),
                         [&](const Class_Entry* served) { return Repository::is_a(served->meta_class, entry.meta_class); });
    return result;
}

std::vector<const zmlr::Meta_Class*> Class_View::subclasses(const zmlr::Meta_Class* parent, bool deep) const
{
    std::vector<const zmlr::Meta_Class*> result = _repository.subclasses(parent, deep);
    std::erase_if(result, [&](const zmlr::Meta_Class* meta_class) { return !shows(meta_class); });
    return result;
}

bool are_related(const zmlr::Meta_Class* a, const zmlr::Meta_Class* b)
{
    return Repository::is_a(a, b) || Repository::is_a(b, a);
}

} // namespace cimserver
