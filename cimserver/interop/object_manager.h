// The server's own description: its CIM_ObjectManager and a CIM_Namespace for each of its name spaces.
#pragma once

#include "cimserver/interop/server_class.h"

#include <string>
#include <vector>

namespace cimserver
{

// One instance: ElementName "zmlr-cimserver", Description "zmlr-cimserver version <version>", Name the element name with the
// host's, so that managers of several hosts tell the servers apart.
Server_Class object_manager_class();

Server_Class name_space_class(const std::vector<std::string>& names);

} // namespace cimserver
