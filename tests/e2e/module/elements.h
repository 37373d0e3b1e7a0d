// What the module's providers share: the elements there are, and who is told of alerts.
#pragma once

#include "schema/TST_Alert.h"
#include "schema/TST_Box.h"
#include "schema/TST_Item.h"

#include <map>
#include <mutex>
#include <string>

namespace zmlr
{

// The boxes by name. At first two, with only a caption: "red" and "blue". Providers take the lock for as long as they look.
struct Boxes
{
    std::mutex mutex;
    std::map<std::string, Ref<TST_Box>> by_name;
};
Boxes& boxes();

// "bolt", "nut", and names that a client has to carry through XML and paths unharmed.
inline constexpr const char* item_names[] = {"bolt", "nut", " two  \"words\" \\ and,more=<&> ", "   "};

TST_Item* make_item(const char* name);
TST_Box* make_box(const char* name);

// Tells an alert to whoever has enabled indications; false when nobody has.
bool raise_alert(uint32 number, const String& text);

} // namespace zmlr
