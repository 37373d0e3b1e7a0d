// What the CIM server that runs the module tells of itself: the texts of its own object manager.
#pragma once

#include "runtime/property.h"
#include "runtime/string.h"

#include <optional>

namespace zmlr
{

// "CIM Server" three times when the server has no object manager, or does not answer. The name is never empty, since it is a key.
struct Own_Object_Manager
{
    String name = "CIM Server";
    Property<String> element_name = {"CIM Server", 0};
    Property<String> description = {"CIM Server", 0};
};

// Asks the server, with one enumeration. Nothing while the calling thread is asking already: then a server that shows the
// module's classes among its own has passed the question back to the module.
std::optional<Own_Object_Manager> own_object_manager();

} // namespace zmlr
