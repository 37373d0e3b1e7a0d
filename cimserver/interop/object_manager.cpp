#include "cimserver/interop/object_manager.h"

#include "cimserver/interop/server_schema.h"
#include "cimserver/model/cim_types.h"
#include "cimserver/model/server_identity.h"

#include <algorithm>
#include <iterator>

namespace cimserver
{
namespace
{

constexpr const char* product = "zmlr-cimserver";
constexpr const char* system_class = "CIM_ComputerSystem";

Value text(std::string value) { return {CMPI_string, std::move(value)}; }

std::string manager_name() { return std::string(product) + ':' + host_name(); }

// An instance whose keys stand in its path and among its properties.
Instance with_keys(const zmlr::Meta_Class& meta_class, std::vector<Named_Value> keys)
{
    return {{"", "", meta_class.name, keys}, keys};
}

std::vector<Instance> object_managers()
{
    Instance instance = with_keys(CIM_ObjectManager, {{"SystemCreationClassName", text(system_class)},
                                                      {"SystemName", text(host_name())},
                                                      {"CreationClassName", text("CIM_ObjectManager")},
                                                      {"Name", text(manager_name())}});
    instance.properties.put("ElementName", text(product));
    instance.properties.put("Description", text(std::string(product) + " version " + version()));
    instance.properties.put("Started", {CMPI_boolean, true});
    instance.properties.put("GatherStatisticalData", {CMPI_boolean, false});
    instance.properties.put("OperationalStatus",
                            {array_of(CMPI_uint16), std::vector<Value>{{CMPI_uint16, std::uint64_t{2}}}}); // OK
    return {instance};
}

Instance name_space_instance(const std::string& name)
{
    Instance instance = with_keys(CIM_Namespace, {{"SystemCreationClassName", text(system_class)},
                                                  {"SystemName", text(host_name())},
                                                  {"ObjectManagerCreationClassName", text("CIM_ObjectManager")},
                                                  {"ObjectManagerName", text(manager_name())},
                                                  {"CreationClassName", text("CIM_Namespace")},
                                                  {"Name", text(name)}});
    instance.properties.put("ClassInfo", {CMPI_uint16, std::uint64_t{11}});
    instance.properties.put("ClassType", {CMPI_uint16, std::uint64_t{2}});
    return instance;
}

} // namespace

Server_Class object_manager_class() { return {CIM_ObjectManager, object_managers, {}, {}}; }

Server_Class name_space_class(const std::vector<std::string>& names)
{
    std::vector<Instance> instances;
    std::ranges::transform(names, std::back_inserter(instances), name_space_instance);
    return {CIM_Namespace, [instances] { return instances; }, {}, {}};
}

} // namespace cimserver
