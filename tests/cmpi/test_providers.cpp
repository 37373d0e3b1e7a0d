#include "tests/cmpi/test_providers.h"

#include "cmpi/provider_proc.h"

namespace test
{

namespace
{

template <class T, template <class> class Base> class Scripted_Provider : public Base<T>
{
public:
    Scripted_Provider() { ++Script::get().providers; }
    ~Scripted_Provider() override { --Script::get().providers; }

    static Scripted_Provider* create() { return new Scripted_Provider; }
    static int invoke(Scripted_Provider&, const T*, Instance*) { return -1; }

    Load_Status load() override
    {
        ++Script::get().loads;
        if (Script::get().on_load)
            Script::get().on_load();
        return LOAD_FAILED; // nobody asks
    }

    Unload_Status unload() override
    {
        ++Script::get().unloads;
        if (Script::get().on_unload)
            Script::get().on_unload();
        return UNLOAD_FAILED; // nobody asks
    }

    Get_Instance_Status get_instance(const T* model, T*& instance) override
    {
        Script& script = Script::get();
        script.model.reset(clone(static_cast<const Instance*>(model)));
        if (script.get_instance == GET_INSTANCE_OK && !script.instances.empty())
            instance = static_cast<T*>(clone(script.instances.front().ptr()));
        return script.get_instance;
    }

    Enum_Instances_Status enum_instances(const T* model, Enum_Instances_Handler<T>& handler) override
    {
        Script& script = Script::get();
        ++script.enumerations;
        script.model.reset(clone(static_cast<const Instance*>(model)));
        if (script.on_enum)
            script.on_enum();
        for (const Ref<Instance>& instance : script.instances)
        {
            ++script.delivered;
            if (!handler.handle(static_cast<T*>(clone(instance.ptr()))) && !script.deaf)
                break;
        }
        return script.enum_instances;
    }

    Create_Instance_Status create_instance(T* instance) override
    {
        Script::get().instance.reset(clone(static_cast<Instance*>(instance)));
        return Script::get().create_instance;
    }

    Modify_Instance_Status modify_instance(const T* model, const T* instance) override
    {
        Script::get().model.reset(clone(static_cast<const Instance*>(model)));
        Script::get().instance.reset(clone(static_cast<const Instance*>(instance)));
        return Script::get().modify_instance;
    }

    Delete_Instance_Status delete_instance(const T* instance) override
    {
        Script::get().instance.reset(clone(static_cast<const Instance*>(instance)));
        return Script::get().delete_instance;
    }
};

using Thing_Provider = Scripted_Provider<Test_Thing, Instance_Provider>;

class Link_Provider : public Scripted_Provider<Test_Link, Association_Provider>
{
public:
    static Link_Provider* create() { return new Link_Provider; }
    static int invoke(Link_Provider&, const Test_Link*, Instance*) { return -1; }

    Enum_Associator_Names_Status enum_associator_names(const Instance*, const String&, const String&, const String&,
                                                       Enum_Associator_Names_Handler<Instance>&) override
    {
        return Script::get().enum_associator_names;
    }

    Enum_References_Status enum_references(const Instance*, const Test_Link*, const String&,
                                           Enum_References_Handler<Test_Link>&) override
    {
        return Script::get().enum_references;
    }
};

int thing_proc(const Registration*, int operation, void* arg0, void* arg1, void* arg2, void* arg3, void* arg4, void* arg5,
               void* arg6, void* arg7)
{
    void* const args[] = {arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7};
    return instance_provider_proc<Thing_Provider>(operation, Thing_Provider::create, args);
}

int link_proc(const Registration*, int operation, void* arg0, void* arg1, void* arg2, void* arg3, void* arg4, void* arg5,
              void* arg6, void* arg7)
{
    void* const args[] = {arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7};
    return association_provider_proc<Link_Provider>(operation, Link_Provider::create, args);
}

Script script;

} // namespace

Script& Script::get() { return script; }
Script& Script::fresh() { return script = Script(); }

constinit const Registration thing_registration = {"Test_Module", "Test_Thing_Provider", thing_proc,
                                                   &Test_Thing::static_meta_class, nullptr};
constinit const Registration link_registration = {"Test_Module", "Test_Link_Provider", link_proc, &Test_Link::static_meta_class,
                                                  &thing_registration};

} // namespace test
