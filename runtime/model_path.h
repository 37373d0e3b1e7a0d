// Model paths: the keys of an instance as one line of text.
//
//     ZEMLAR_ComputerSystem.Name="host1",CreationClassName="ZEMLAR_ComputerSystem"
//
// Booleans, numbers and datetimes (25 characters) stand bare, a char16 between single quotes, strings between double quotes,
// a referenced object as its own path between double quotes, with a backslash before each double quote in it.
#pragma once

#include "runtime/instance.h"

namespace zmlr
{

// Writes the path of the instance: 0, or -1 (and the path incomplete) when its class has no keys, a key is null or an array,
// or the object of a key reference has no path. Texts are written as they are: one that holds a double quote or a backslash
// does not read back.
int instance_to_model_path(const Instance* instance, String& out);

// Reads a path: a new instance of the class that it names, with those keys and nothing else; keys that the path leaves out are
// null. The class is `meta_class`, one of its ancestors, or one of its repository. Null when the text is no path, holds an
// unknown name, a name twice, or a value that does not fit its key. In a quoted text a backslash stands before a double quote
// or another backslash, and before nothing else; integers may be hexadecimal ("0x1F").
Instance* model_path_to_instance(const Meta_Class* meta_class, const char* path);

} // namespace zmlr
