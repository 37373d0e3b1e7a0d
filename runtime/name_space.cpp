#include "runtime/features.h"

namespace zmlr
{

namespace
{

struct Name_Space_Change
{
    String name_space;
    bool force;
};

void set_name_space(Instance* instance, void* data)
{
    const auto* change = static_cast<const Name_Space_Change*>(data);
    if (change->force || instance->__name_space.empty())
        instance->__name_space = change->name_space;
}

} // namespace

void __visit(Instance* instance, void (*callback)(Instance* instance, void* data), void* data)
{
    check_inst(instance);
    callback(instance, data);
    for (const Meta_Feature* feature : features_of(instance))
    {
        if (const Meta_Reference* single = to_single_reference(feature))
        {
            if (Instance* referenced = reference_of(instance, single))
                __visit(referenced, callback, data);
        }
        else if (const Meta_Reference* array = to_array_reference(feature))
        {
            for (Instance* element : references_of(instance, array))
                if (element)
                    __visit(element, callback, data);
        }
    }
}

void __set_name_space_recursive(Instance* instance, const String& name_space, bool force)
{
    Name_Space_Change change = {name_space, force};
    __visit(instance, set_name_space, &change);
}

} // namespace zmlr
