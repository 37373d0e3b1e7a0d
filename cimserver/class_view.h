// Class_View: the classes of a module that one name space shows.
#pragma once

#include "cimserver/broker/repository.h"

#include <span>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace cimserver
{

// Read only once made, so threads share it without a lock. The repository must outlive it.
class Class_View
{
public:
    explicit Class_View(const Repository& repository); // all classes

    // The served classes that are one of `roots` or derive from one; with them their ancestors and the classes that their
    // references name.
    Class_View(const Repository& repository, std::span<const std::string_view> roots);

    const Repository& repository() const { return _repository; }

    const Class_Entry* find(std::string_view class_name) const; // null when the name space has no such class

    // The served classes in the order of their registration: all, or those that are `entry`'s or derive from it.
    std::vector<const Class_Entry*> served() const;
    std::vector<const Class_Entry*> served(const Class_Entry& entry) const;

    // The direct subclasses of a class, or with `deep` all that derive from it; with a null parent those at the top.
    std::vector<const zmlr::Meta_Class*> subclasses(const zmlr::Meta_Class* parent, bool deep) const;

private:
    void show(const zmlr::Meta_Class* meta_class);
    bool shows(const zmlr::Meta_Class* meta_class) const { return _all || _shown.contains(meta_class); }

    const Repository& _repository;
    const bool _all;
    std::unordered_set<const zmlr::Meta_Class*> _shown;
    std::vector<const Class_Entry*> _served;
};

// Whether one of two classes is the other or derives from it.
bool are_related(const zmlr::Meta_Class* a, const zmlr::Meta_Class* b);

} // namespace cimserver
