// Object paths as texts, and when two of them name the same instance.
#pragma once

#include "cimserver/model/values.h"

#include <string>
#include <unordered_set>
#include <vector>

namespace cimserver
{

// The path as one line: "root/zemlar:Class.Key=value,...", texts and referenced paths between double quotes. Each level of
// references doubles the escapes below it: not for paths whose depth nobody has checked.
std::string path_text(const Object_Path& path);

// A text that two paths share exactly when they name the same instance: the case of names and the order of keys do not count,
// hosts neither (every object is on this one). Not for paths whose depth nobody has checked (typed_keys.h).
std::string path_identity(const Object_Path& path);

inline const Object_Path& path_of(const Object_Path& path) { return path; }
inline const Object_Path& path_of(const Instance& instance) { return instance.path; }

// Removes what names the same instance as an element before it. The objects are paths or instances.
template <class T> void remove_duplicates(std::vector<T>& objects)
{
    std::unordered_set<std::string> seen;
    std::erase_if(objects, [&](const T& object) { return !seen.insert(path_identity(path_of(object))).second; });
}

} // namespace cimserver
