#include "runtime/features.h"

namespace zmlr
{

namespace
{

// Whether a request's filter lets a name pass: an empty one lets every name pass.
bool accepts(const char* filter, const char* name) { return !filter || !*filter || eqi(filter, name); }

bool accepts_class(const char* filter, const Meta_Class* meta_class)
{
    for (const Meta_Class* c = meta_class; c; c = c->super_meta_class)
        if (accepts(filter, c->name))
            return true;
    return false;
}

void check_association(const Instance* inst, const Instance* assoc_inst, const char* file = __builtin_FILE(),
                       int line = __builtin_LINE(), const char* function = __builtin_FUNCTION())
{
    check_inst(inst, file, line, function);
    check_instance(assoc_inst, "assoc_inst != 0", "assoc_inst->__magic == CIMPLE_INSTANCE_MAGIC", file, line, function);
}

} // namespace

int get_associators(const Instance* instance, const Instance* association, const char* result_class, const char* role,
                    const char* result_role, const Instance** out)
{
    check_association(instance, association);
    int count = 0;
    bool concerned = false;
    for (const Meta_Feature* feature : features_of(association))
    {
        const Meta_Reference* reference = to_single_reference(feature);
        const Instance* p = reference ? reference_of(association, reference) : nullptr;
        if (!p)
            continue;

        check_instance(p, "p != 0", "p->__magic == CIMPLE_INSTANCE_MAGIC");
        if (is_subclass(reference->meta_class, instance->meta_class) && key_eq(p, instance))
            concerned = concerned || accepts(role, reference->name);
        else if (accepts_class(result_class, p->meta_class) && accepts(result_role, reference->name))
            out[count++] = p;
    }
    return concerned ? count : -1;
}

bool is_reference_of(const Instance* instance, const Instance* association, const char* role)
{
    check_association(instance, association);
    for (const Meta_Feature* feature : features_of(association))
    {
        const Meta_Reference* reference = to_single_reference(feature);
        const Instance* p = reference ? reference_of(association, reference) : nullptr;
        if (p && accepts(role, reference->name) && key_eq(p, instance))
            return true;
    }
    return false;
}

} // namespace zmlr
