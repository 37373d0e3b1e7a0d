#include "cimserver/interop/object_manager.h"

#include "cimserver/cimxml/version.h"
#include "cimserver/host_name.h"
#include "cimserver/interop/server_schema.h"

namespace cimserver
{
namespace
{

constexpr const char* product = "zmlr-cimserver";
constexpr const char* system_class = "CIM_ComputerSystem";

Value text(std::string value) { return {CMPI_string, std::move(value)}; }

Value array_of(const Value& element) { return {static_cast<CMPIType>(element.type | CMPI_ARRAY), std::vector<Value>{element}}; }

std::string manager_name() { return std::string(product) + ':' + host_name(); }

// An instance whose keys stand in its path and among its properties.
Instance with_keys(const zmlr::Meta_Class& meta_class, std::vector<Named_Value> keys)
{
    return {{"", "", meta_class.name, keys}, keys};
}

class Object_Manager : public Server_Class
{
public:
    const zmlr::Meta_Class& meta_class() const override { return CIM_ObjectManager; }

    std::vector<Instance> enumerate() override
    {
        Instance instance = with_keys(CIM_ObjectManager, {{"SystemCreationClassName", text(system_class)},
                                                          {"SystemName", text(host_name())},
                                                          {"CreationClassName", text("CIM_ObjectManager")},
                                                          {"Name", text(manager_name())}});
        instance.properties.push_back({"ElementName", text(product)});
        instance.properties.push_back({"Description", text(std::string(product) + " version " + version())});
        instance.properties.push_back({"Started", {CMPI_boolean, true}});
        instance.properties.push_back({"GatherStatisticalData", {CMPI_boolean, false}});
        instance.properties.push_back({"OperationalStatus", array_of({CMPI_uint16, std::uint64_t{2}})}); // OK
        return {instance};
    }
};

class Name_Space_Class : public Server_Class
{
public:
    explicit Name_Space_Class(std::vector<std::string> name_spaces) : _name_spaces(std::move(name_spaces)) {}

    const zmlr::Meta_Class& meta_class() const override { return CIM_Namespace; }

    std::vector<Instance> enumerate() override
    {
        std::vector<Instance> instances;
        for (const std::string& name : _name_spaces)
        {
            instances.push_back(with_keys(CIM_Namespace, {{"SystemCreationClassName", text(system_class)},
                                                          {"SystemName", text(host_name())},
                                                          {"ObjectManagerCreationClassName", text("CIM_ObjectManager")},
                                                          {"ObjectManagerName", text(manager_name())},
                                                          {"CreationClassName", text("CIM_Namespace")},
                                                          {"Name", text(name)}}));
            instances.back().properties.push_back({"ClassInfo", {CMPI_uint16, std::uint64_t{11}}});
            instances.back().properties.push_back({"ClassType", {CMPI_uint16, std::uint64_t{2}}});
        }
        return instances;
    }

private:
    const std::vector<std::string> _name_spaces;
};

} // namespace

std::unique_ptr<Server_Class> make_object_manager() { return std::make_unique<Object_Manager>(); }

std::unique_ptr<Server_Class> make_name_space_class(std::vector<std::string> name_spaces)
{
    return std::make_unique<Name_Space_Class>(std::move(name_spaces));
}

} // namespace cimserver
