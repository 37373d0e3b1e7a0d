#include "elements.h"

namespace zmlr
{

Boxes& boxes()
{
    static Boxes boxes{{}, {{"red", Ref(make_box("red"))}, {"blue", Ref(make_box("blue"))}}};
    return boxes;
}

TST_Item* make_item(const char* name)
{
    TST_Item* item = TST_Item::create();
    item->Name.set(name);
    item->Caption.set(String("the item ") + name);
    return item;
}

TST_Box* make_box(const char* name)
{
    TST_Box* box = TST_Box::create();
    box->Name.set(name);
    box->Caption.set(String("the box ") + name);
    return box;
}

} // namespace zmlr
