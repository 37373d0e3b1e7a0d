#include "elements.h"
#include "providers/TST_Holds_Provider_Skeleton.h"
#include "providers/TST_Labels_Provider_Skeleton.h"
#include "schema/TST_Element.h"

#include <cstring>

namespace zmlr
{

namespace
{

// The red box holds a bolt and a nut, the blue one the item with the words.
class TST_Holds_Provider final : public TST_Holds_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        uint32 position = 0;
        for (const auto& [box, item] : {std::pair{"red", item_names[0]}, {"red", item_names[1]}, {"blue", item_names[2]}})
        {
            Class* holds = Class::create();
            holds->Container = make_box(box);
            holds->Content = make_item(item);
            holds->Position.set(++position);
            handler.handle(holds);
        }
        return ENUM_INSTANCES_OK;
    }
};

// The red box is labelled with its bolt and with the blue box. Answers associators itself.
class TST_Labels_Provider final : public TST_Labels_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        for (TST_Element* content : {element(make_item("bolt")), element(make_box("blue"))})
        {
            Class* labels = Class::create();
            labels->Container = make_box("red");
            labels->Content = content;
            handler.handle(labels);
        }
        return ENUM_INSTANCES_OK;
    }

    Enum_Associators_Status enum_associators(const Instance* instance, const String& result_class, const String& role,
                                             const String& result_role, Enum_Associators_Handler<Instance>& handler) override
    {
        struct Search
        {
            const Instance* instance;
            const char* result_class;
            const char* role;
            const char* result_role;
            Enum_Associators_Handler<Instance>& handler;
        } search{instance, result_class.c_str(), role.c_str(), result_role.c_str(), handler};

        Enum_Instances_Handler<Class> collect(
            [](Instance* labels, Enum_Instances_Status, void* data)
            {
                const Ref<Instance> owned(labels);
                const auto& s = *static_cast<Search*>(data);
                const Instance* found[2];
                const int count = get_associators(s.instance, labels, s.result_class, s.role, s.result_role, found);
                for (int i = 0; i < count; ++i)
                    s.handler.handle(clone(found[i]));
                return true;
            },
            &search);
        enum_instances(nullptr, collect);
        return ENUM_ASSOCIATORS_OK;
    }

private:
    template <class T> static TST_Element* element(T* instance)
    {
        return static_cast<TST_Element*>(static_cast<Instance*>(instance));
    }
};

} // namespace

TST_Holds_Provider_Skeleton* create_TST_Holds_Provider() { return new TST_Holds_Provider; }
TST_Labels_Provider_Skeleton* create_TST_Labels_Provider() { return new TST_Labels_Provider; }

} // namespace zmlr
