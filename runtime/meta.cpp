#include "runtime/meta.h"

#include "runtime/features.h"
#include "runtime/string.h"

#include <span>

namespace zmlr
{

namespace
{

template <class T> bool is_named(const T* meta, const char* name) { return eqi(meta->name, name); }

} // namespace

constinit const char* const flag_names[num_flag_names] = {
    "Property",    "Reference", "Method",   "Class",      "Abstract",       "Aggregate", "Aggregation", "Association",
    "Composition", "Counter",   "Delete",   "DN",         "EmbeddedObject", "Exception", "Expensive",   "Experimental",
    "Gauge",       "IfDeleted", "In",       "Indication", "Invisible",      "Key",       "Large",       "OctetString",
    "Out",         "Read",      "Required", "Static",     "Terminal",       "Weak",      "Write",       "EmbeddedInstance",
};

uint32 flag_name_to_index(const char* name)
{
    for (uint32 i = 0; i < num_flag_names; ++i)
        if (eqi(flag_names[i], name))
            return i;
    return 0xFFFFFFFF;
}

const Meta_Class* find_meta_class(const Meta_Repository* repository, const char* name)
{
    if (!repository)
        return nullptr;
    for (const Meta_Class* meta_class : std::span(repository->meta_classes, repository->num_meta_classes))
        if (is_named(meta_class, name))
            return meta_class;
    return nullptr;
}

const Meta_Class* find_meta_class(const Meta_Class* meta_class, const char* name)
{
    for (const Meta_Class* c = meta_class; c; c = c->super_meta_class)
        if (is_named(c, name))
            return c;
    return find_meta_class(meta_class->meta_repository, name);
}

bool is_subclass(const Meta_Class* ancestor, const Meta_Class* descendant)
{
    if (is_named(ancestor, Instance::static_meta_class.name))
        return true;
    if (is_method(descendant)) // a parameter record, which has no class above it
        return false;
    for (const Meta_Class* c = descendant; c; c = c->super_meta_class)
        if (c == ancestor || is_named(c, ancestor->name))
            return true;
    return false;
}

const Meta_Feature* find_feature(const Meta_Record* record, const char* name, uint32 kind_mask)
{
    for (const Meta_Feature* feature : features_of(record))
        if ((feature->flags & kind_mask) != 0 && is_named(feature, name))
            return feature;
    return nullptr;
}

const Meta_Property* find_property(const Meta_Class* meta_class, const char* name)
{
    return as_property(find_feature(meta_class, name, Flag_Property));
}

const Meta_Reference* find_reference(const Meta_Class* meta_class, const char* name)
{
    return as_reference(find_feature(meta_class, name, Flag_Reference));
}

const Meta_Method* find_method(const Meta_Class* meta_class, const char* name)
{
    return as_method(find_feature(meta_class, name, Flag_Method));
}

const Meta_Feature* find_parameter(const Meta_Method* meta_method, const char* name, uint32 kind_mask)
{
    return find_feature(meta_method, name, kind_mask);
}

const Meta_Reference* find_reference(const Meta_Method* meta_method, const char* name)
{
    return as_reference(find_feature(meta_method, name, Flag_Reference));
}

bool has_feature(const Meta_Class* meta_class, uint32 kind_mask)
{
    for (const Meta_Feature* feature : features_of(meta_class))
        if ((feature->flags & kind_mask) != 0)
            return true;
    return false;
}

void ref(const Meta_Class* meta_class)
{
    if (Atomic_get(&meta_class->refs) != 0)
        Atomic_inc(const_cast<Atomic*>(&meta_class->refs));
}

void unref(const Meta_Class* meta_class)
{
    if (Atomic_get(&meta_class->refs) != 0 && Atomic_dec_and_test(const_cast<Atomic*>(&meta_class->refs)))
        delete meta_class;
}

} // namespace zmlr
