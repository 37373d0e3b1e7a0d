#include "tests/cmpi/test_providers.h"

#include "cmpi/provider_proc.h"

#include <atomic>

namespace test
{

namespace
{

// A provider's use of the script.
class Turn
{
public:
    Script* operator->() const { return &Script::get(); }
    Script& operator*() const { return Script::get(); }

private:
    std::lock_guard<std::recursive_mutex> _guard{Script::turn()};
};

Ref<Instance> copy_of(const Instance* instance) { return Ref<Instance>(clone(instance)); }

// Hands out clones until told to stop; a deaf provider goes on.
template <class T, class Handler> void hand_out(const std::vector<Ref<Instance>>& instances, Handler& handler, Script& script)
{
    for (const Ref<Instance>& instance : instances)
    {
        ++script.delivered;
        if (!handler.handle(static_cast<T*>(clone(instance.ptr()))) && !script.deaf)
            break;
    }
}

// The life of a provider of any kind. It is told without a turn: a provider loads under the lock that a request within a turn
// may want.
template <class Base> class Counted_Provider : public Base
{
public:
    Counted_Provider() { ++std::atomic_ref(Script::get().providers); }
    ~Counted_Provider() override { --std::atomic_ref(Script::get().providers); }

    Load_Status load() override
    {
        ++std::atomic_ref(Script::get().loads);
        if (Script::get().on_load)
            Script::get().on_load();
        return LOAD_FAILED; // nobody asks
    }

    Unload_Status unload() override
    {
        ++std::atomic_ref(Script::get().unloads);
        if (Script::get().on_unload)
            Script::get().on_unload();
        return UNLOAD_FAILED; // nobody asks
    }

    // What a provider without methods answers.
    static int invoke(Base&, const Instance*, Instance*) { return -1; }
};

template <class T, template <class> class Base> class Scripted_Provider : public Counted_Provider<Base<T>>
{
public:
    static Scripted_Provider* create() { return new Scripted_Provider; }

    Get_Instance_Status get_instance(const T* model, T*& instance) override
    {
        const Turn script;
        script->model = copy_of(model);
        if (script->get_instance == GET_INSTANCE_OK && !script->instances.empty())
            instance = static_cast<T*>(clone(script->instances.front().ptr()));
        return script->get_instance;
    }

    Enum_Instances_Status enum_instances(const T* model, Enum_Instances_Handler<T>& handler) override
    {
        const Turn script;
        ++script->enumerations;
        script->model = copy_of(model);
        if (script->on_enum)
            script->on_enum();
        hand_out<T>(script->instances, handler, *script);
        return script->enum_instances;
    }

    Create_Instance_Status create_instance(T* instance) override
    {
        const Turn script;
        script->instance = copy_of(instance);
        return script->create_instance;
    }

    Modify_Instance_Status modify_instance(const T* model, const T* instance) override
    {
        const Turn script;
        script->model = copy_of(model);
        script->instance = copy_of(instance);
        return script->modify_instance;
    }

    Delete_Instance_Status delete_instance(const T* instance) override
    {
        const Turn script;
        script->instance = copy_of(instance);
        return script->delete_instance;
    }
};

using Thing_Provider = Scripted_Provider<TST_Thing, Instance_Provider>;

class Disk_Provider : public Scripted_Provider<TST_Disk, Instance_Provider>
{
public:
    static Disk_Provider* create() { return new Disk_Provider; }
    static int invoke(Disk_Provider&, const TST_Disk* self, Instance* parameters)
    {
        const Turn script;
        script->instance = copy_of(self);
        if (script->on_invoke)
            script->on_invoke(parameters);
        return script->invoke_method;
    }
};

// Delivers associators only when it says that it does.
class Link_Provider : public Scripted_Provider<TST_Pair, Association_Provider>
{
public:
    static Link_Provider* create() { return new Link_Provider; }

    Enum_Associators_Status enum_associators(const Instance*, const String&, const String&, const String&,
                                             Enum_Associators_Handler<Instance>& handler) override
    {
        const Turn script;
        if (script->enum_associators == ENUM_ASSOCIATORS_OK)
            hand_out<Instance>(script->associators, handler, *script);
        return script->enum_associators;
    }

    Enum_Associator_Names_Status enum_associator_names(const Instance*, const String&, const String&, const String&,
                                                       Enum_Associator_Names_Handler<Instance>& handler) override
    {
        const Turn script;
        if (script->enum_associator_names == ENUM_ASSOCIATOR_NAMES_OK)
            hand_out<Instance>(script->associators, handler, *script);
        return script->enum_associator_names;
    }

    Enum_References_Status enum_references(const Instance*, const TST_Pair*, const String&,
                                           Enum_References_Handler<TST_Pair>&) override
    {
        return Script::get().enum_references;
    }
};

class Alert_Provider : public Counted_Provider<Indication_Provider<TST_Alert>>
{
public:
    static Alert_Provider* create() { return new Alert_Provider; }

    Enable_Indications_Status enable_indications(Indication_Handler<TST_Alert>* handler) override
    {
        std::unique_ptr<Indication_Handler<TST_Alert>> own(handler);
        const Turn script;
        ++script->enables;
        if (script->enable_indications == ENABLE_INDICATIONS_OK)
            script->handler = std::move(own);
        if (script->on_enable)
            script->on_enable();
        return script->enable_indications;
    }

    Disable_Indications_Status disable_indications() override
    {
        const Turn script;
        ++script->disables;
        if (script->on_disable)
            script->on_disable();
        script->handler.reset();
        return script->disable_indications;
    }
};

// The procedure of a provider, out of the body for its kind.
template <class P, int (*body)(int, P* (*)(), void* const*)>
int proc(const Registration*, int operation, void* arg0, void* arg1, void* arg2, void* arg3, void* arg4, void* arg5, void* arg6,
         void* arg7)
{
    void* const args[] = {arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7};
    return body(
        operation, []() -> P* { return P::create(); }, args);
}

Script the_script;

} // namespace

Script& Script::get() { return the_script; }
std::recursive_mutex& Script::turn()
{
    static std::recursive_mutex mutex;
    return mutex;
}
Script& Script::fresh() { return the_script = Script(); }

// clang-format off
constinit const Registration thing_registration = {"Test_Module", "Test_Thing_Provider",
    proc<Thing_Provider, instance_provider_proc<Thing_Provider>>, &TST_Thing::static_meta_class, nullptr};
constinit const Registration disk_registration = {"Test_Module", "Test_Disk_Provider",
    proc<Disk_Provider, instance_provider_proc<Disk_Provider>>, &TST_Disk::static_meta_class, &thing_registration};
constinit const Registration link_registration = {"Test_Module", "Test_Link_Provider",
    proc<Link_Provider, association_provider_proc<Link_Provider>>, &TST_Pair::static_meta_class, &disk_registration};
constinit const Registration alert_registration = {"Test_Module", "Test_Alert_Provider",
    proc<Alert_Provider, indication_provider_proc<Alert_Provider>>, &TST_Alert::static_meta_class, &link_registration};
// clang-format on

} // namespace test
