#include "elements.h"
#include "providers/TST_Broken_Provider_Skeleton.h"
#include "providers/TST_Item_Provider_Skeleton.h"
#include "providers/TST_Keyed_Provider_Skeleton.h"
#include "providers/TST_Refusal_Provider_Skeleton.h"
#include "runtime/model_path.h"

#include <cstdlib>

namespace zmlr
{

namespace
{

class TST_Item_Provider final : public TST_Item_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        for (const char* name : item_names)
            handler.handle(make_item(name));
        return ENUM_INSTANCES_OK;
    }
};

class TST_Refusal_Provider final : public TST_Refusal_Provider_Skeleton
{
public:
    Get_Instance_Status get_instance(const Class* model, Class*&) override { return status<Get_Instance_Status>(model); }
    Create_Instance_Status create_instance(Class* instance) override { return status<Create_Instance_Status>(instance); }
    Modify_Instance_Status modify_instance(const Class*, const Class* instance) override
    {
        return status<Modify_Instance_Status>(instance);
    }
    Delete_Instance_Status delete_instance(const Class* instance) override { return status<Delete_Instance_Status>(instance); }

private:
    template <class Status> static Status status(const Class* instance)
    {
        return static_cast<Status>(std::atoi(instance->Name.value.c_str()));
    }
};

class TST_Keyed_Provider final : public TST_Keyed_Provider_Skeleton
{
public:
    Get_Instance_Status get_instance(const Class* model, Class*& instance) override
    {
        String path;
        instance_to_model_path(model, path);
        instance = clone(model);
        instance->Path.set(path);
        return GET_INSTANCE_OK;
    }

    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        handler.handle(static_cast<Class*>(static_cast<Instance*>(make_box("red"))));
        return ENUM_INSTANCES_OK;
    }
};

class TST_Broken_Provider final : public TST_Broken_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>&) override
    {
        return ENUM_INSTANCES_ACCESS_DENIED;
    }
};

} // namespace

TST_Broken_Provider_Skeleton* create_TST_Broken_Provider() { return new TST_Broken_Provider; }
TST_Item_Provider_Skeleton* create_TST_Item_Provider() { return new TST_Item_Provider; }
TST_Keyed_Provider_Skeleton* create_TST_Keyed_Provider() { return new TST_Keyed_Provider; }
TST_Refusal_Provider_Skeleton* create_TST_Refusal_Provider() { return new TST_Refusal_Provider; }

} // namespace zmlr
