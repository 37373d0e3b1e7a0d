#include "cimserver/interop/server_class.h"

#include "cimserver/model/paths.h"

namespace cimserver
{

std::optional<Instance> find_instance(const Server_Class& server_class, const Object_Path& path)
{
    const std::string wanted = path_identity(path);
    for (Instance& instance : server_class.enumerate())
    {
        instance.path.name_space = path.name_space;
        if (path_identity(instance.path) == wanted)
            return std::move(instance);
    }
    return std::nullopt;
}

} // namespace cimserver
