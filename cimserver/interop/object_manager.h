// The server's own description: its CIM_ObjectManager and a CIM_Namespace for each of its name spaces.
#pragma once

#include "cimserver/interop/server_class.h"

#include <memory>
#include <string>
#include <vector>

namespace cimserver
{

// One instance: ElementName "zmlr-cimserver", Description "zmlr-cimserver version <version>", Name the element name with the
// host's, so that managers of several hosts tell the servers apart.
std::unique_ptr<Server_Class> make_object_manager();

std::unique_ptr<Server_Class> make_name_space_class(std::vector<std::string> name_spaces);

} // namespace cimserver
