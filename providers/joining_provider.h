// The provider of every association class that providers.def marks JOINED: the generator binds the class's skeleton to it, and
// with it to the class's row in one of the tables of joins.h. A class without a row does not compile.
#pragma once

#include "providers/joining.h"
#include "providers/joins.h"
#include "runtime/trace.h"

namespace zmlr
{

template <class Skeleton> class Joining_Provider final : public Skeleton
{
public:
    using Class = typename Skeleton::Class;

    // The name by which the provider logs.
    explicit Joining_Provider(const char* name) : _name(name) {}

    // Always a success. Associators and references are answered from it.
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        const Scope_Trace trace(_name, "enum_instances");
        Joining joining(_row, _name,
                        [&handler](Instance* association) { return handler.handle(static_cast<Class*>(association)); });
        _row.match(joining);
        return ENUM_INSTANCES_OK;
    }

private:
    static constexpr const Join& _row = join_of(Class::static_meta_class);

    const char* _name;
};

} // namespace zmlr
