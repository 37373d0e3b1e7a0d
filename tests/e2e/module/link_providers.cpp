#include "elements.h"
#include "providers/TST_Holds_Provider_Skeleton.h"
#include "providers/TST_Labels_Provider_Skeleton.h"
#include "schema/TST_Element.h"

#include <utility>

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

// The red box is labelled with its bolt and with the blue box.
class TST_Labels_Provider final : public TST_Labels_Provider_Skeleton
{
public:
    Enum_Instances_Status enum_instances(const Class*, Enum_Instances_Handler<Class>& handler) override
    {
        for (Instance* content : {static_cast<Instance*>(make_item("bolt")), static_cast<Instance*>(make_box("blue"))})
        {
            Class* labels = Class::create();
            labels->Container = make_box("red");
            labels->Content = static_cast<TST_Element*>(content);
            handler.handle(labels);
        }
        return ENUM_INSTANCES_OK;
    }
};

} // namespace

TST_Holds_Provider_Skeleton* create_TST_Holds_Provider() { return new TST_Holds_Provider; }
TST_Labels_Provider_Skeleton* create_TST_Labels_Provider() { return new TST_Labels_Provider; }

} // namespace zmlr
