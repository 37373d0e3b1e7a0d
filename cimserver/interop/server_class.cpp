#include "cimserver/interop/server_class.h"

#include "cimserver/path_identity.h"

#include <algorithm>

namespace cimserver
{
namespace
{

[[noreturn]] void refuse(const zmlr::Meta_Class& meta_class, const char* what)
{
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string("instances of ") + meta_class.name + " cannot be " + what);
}

} // namespace

std::optional<Instance> Server_Class::get(const Object_Path& path)
{
    std::vector<Instance> instances = enumerate();
    const std::string wanted = path_identity(path);
    const auto found = std::ranges::find_if(instances,
                                            [&](Instance& instance)
                                            {
                                                instance.path.name_space = path.name_space;
                                                return path_identity(instance.path) == wanted;
                                            });
    if (found == instances.end())
        return std::nullopt;
    return std::move(*found);
}

Object_Path Server_Class::create(const Instance&) { refuse(meta_class(), "created"); }
void Server_Class::remove(const Object_Path&) { refuse(meta_class(), "deleted"); }

} // namespace cimserver
