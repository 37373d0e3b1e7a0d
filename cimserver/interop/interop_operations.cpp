#include "cimserver/interop/interop_operations.h"

#include <algorithm>
#include <iterator>

namespace cimserver
{
namespace
{

constexpr std::string_view module_roots[] = {
#define ZMLR_INTEROP_ROOT(Class) #Class,
#include "cimserver/interop/interop_roots.def"
#undef ZMLR_INTEROP_ROOT
};

} // namespace

Interop_Operations::Interop_Operations(Module& module)
    : Module_Operations(module, name_space, module_roots)
    , _own(module.repository())
{
}

// A class without keys has no instance of its own.
Operations& Interop_Operations::at(const std::string& class_name)
{
    const Class_Entry* own = _own.classes().find(class_name);
    if (own && own->meta_class->num_keys > 0)
        return _own;
    return *this;
}

bool Interop_Operations::only_own(const std::string& class_name) const
{
    return _own.classes().find(class_name) && !classes().find(class_name);
}

const zmlr::Meta_Class* Interop_Operations::get_class(const std::string& class_name)
{
    return only_own(class_name) ? _own.get_class(class_name) : Module_Operations::get_class(class_name);
}

std::vector<const zmlr::Meta_Class*> Interop_Operations::enumerate_classes(const std::string& class_name, bool deep_inheritance)
{
    std::vector<const zmlr::Meta_Class*> found;
    if (class_name.empty() || _own.classes().find(class_name))
        found = _own.enumerate_classes(class_name, deep_inheritance);
    if (!only_own(class_name))
        for (const zmlr::Meta_Class* meta_class : Module_Operations::enumerate_classes(class_name, deep_inheritance))
            if (!_own.classes().find(meta_class->name))
                found.push_back(meta_class);
    return found;
}

std::vector<Object_Path> Interop_Operations::enumerate_instance_names(const std::string& class_name)
{
    std::vector<Object_Path> found;
    if (_own.classes().find(class_name))
        found = _own.enumerate_instance_names(class_name);
    if (!only_own(class_name))
        std::ranges::move(Module_Operations::enumerate_instance_names(class_name), std::back_inserter(found));
    return found;
}

std::vector<Instance> Interop_Operations::enumerate_instances(const std::string& class_name, bool deep_inheritance,
                                                              const Property_List& properties)
{
    std::vector<Instance> found;
    if (_own.classes().find(class_name))
        found = _own.enumerate_instances(class_name, deep_inheritance, properties);
    if (!only_own(class_name))
        std::ranges::move(Module_Operations::enumerate_instances(class_name, deep_inheritance, properties),
                          std::back_inserter(found));
    return found;
}

} // namespace cimserver
