// Repository: the classes of a module, found by name, and which of them it serves.
//
// Built once from the list that cimple_module() answers; read only afterwards, so threads share it without a lock. It
// points into the module's constant data and must not outlive the module.
#pragma once

#include "cimserver/model/names.h"
#include "cimserver/model/property_layout.h"
#include "cmpi/registration.h"

#include <memory>
#include <span>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace cimserver
{

struct Class_Entry
{
    Name name;
    const zmlr::Meta_Class* meta_class;
    std::shared_ptr<const Property_Layout> layout;
    const zmlr::Registration* registration; // null when no provider serves the class itself
};

class Repository
{
public:
    // `head` is the module's list, last registered first. Throws std::runtime_error when a record is incomplete.
    explicit Repository(const zmlr::Registration* head);

    // What a name space shows of another repository: the served classes that are one of `roots` or derive from one; with them
    // their ancestors and the classes that their references name. It has the other one's entries, which must outlive it.
    Repository(const Repository& whole, std::span<const std::string_view> roots);
    Repository(const Repository&) = delete;
    Repository& operator=(const Repository&) = delete;

    const Class_Entry* find(std::string_view class_name) const; // null when the module does not know the class
    const Class_Entry& get(std::string_view class_name, int unknown = CIM_ERR_INVALID_CLASS) const; // throws Cim_Error `unknown`

    // Whether a class is `ancestor` or derives from it.
    static bool is_a(const zmlr::Meta_Class* meta_class, const zmlr::Meta_Class* ancestor);

    // The served classes in the order of their registration: all, or those that are `entry`'s or derive from it.
    const std::vector<const Class_Entry*>& served() const { return _served; }
    const std::vector<const Class_Entry*>& served(const Class_Entry& entry) const;

    // The direct subclasses of a class, or with `deep` all that derive from it; with a null parent those at the top.
    std::vector<const zmlr::Meta_Class*> subclasses(const zmlr::Meta_Class* parent, bool deep) const;

private:
    using Entry = std::shared_ptr<Class_Entry>;

    void add(const zmlr::Meta_Class& meta_class);
    void index_served();
    void show(const Repository& whole, const zmlr::Meta_Class* meta_class);
    bool at_top(const zmlr::Meta_Class* meta_class) const;

    std::vector<Entry> _entries;
    Name_Map<Class_Entry*> _index;
    std::vector<const Class_Entry*> _served; // first registered first
    std::unordered_map<const zmlr::Meta_Class*, std::vector<const Class_Entry*>> _served_by_class;
};

// Whether one of two classes is the other or derives from it.
bool are_related(const zmlr::Meta_Class* a, const zmlr::Meta_Class* b);

} // namespace cimserver
