#include "elements.h"
#include "providers/TST_Item_Provider_Skeleton.h"
#include "providers/TST_Refusal_Provider_Skeleton.h"

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

} // namespace

TST_Item_Provider_Skeleton* create_TST_Item_Provider() { return new TST_Item_Provider; }
TST_Refusal_Provider_Skeleton* create_TST_Refusal_Provider() { return new TST_Refusal_Provider; }

} // namespace zmlr
