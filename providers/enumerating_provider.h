// The provider of every class that providers.def marks ENUMERATED: the generator binds the class's skeleton to it, and with it to
// the row of enumerations.h that names the class. A class without a row does not compile.
//
// A provider that does more derives from it in a source of its own and is marked WRITTEN; its row stays.
#pragma once

#include "providers/delivery.h"
#include "providers/enumerations.h"
#include "providers/row_of.h"
#include "runtime/trace.h"

#include <utility>

namespace zmlr
{

template <class Skeleton> class Enumerating_Provider : public Skeleton
{
public:
    using Class = typename Skeleton::Class;

    // The name by which the provider logs.
    explicit Enumerating_Provider(const char* name) : _name(name) {}

    // Left to the enumeration that follows with the same model: that one is for a single instance, whatever keys other
    // enumerations come with.
    Get_Instance_Status get_instance(const Class* model, Class*&) override
    {
        _wanted = model;
        return GET_INSTANCE_UNSUPPORTED;
    }

    // Always a success.
    Enum_Instances_Status enum_instances(const Class* model, Enum_Instances_Handler<Class>& handler) override
    {
        const Scope_Trace trace(_name, "enum_instances");
        const Class* wanted = std::exchange(_wanted, nullptr);
        Instance_Array instances = instances_of(_row, wanted == model ? wanted : nullptr, _name);
        deliver(instances, handler);
        return ENUM_INSTANCES_OK;
    }

protected:
    const char* name() const { return _name; }

private:
    static constexpr const Enumeration& _row = row_of(Class::static_meta_class, enumerations);

    const char* _name;
    const Class* _wanted = nullptr; // the model of a get_instance whose enumeration has not come yet
};

} // namespace zmlr
