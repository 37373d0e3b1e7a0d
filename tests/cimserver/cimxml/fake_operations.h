// Operations that serve the test classes in "root/test": two ports, and a record of the last call's arguments.
#pragma once

#include "cimserver/broker/names.h"
#include "cimserver/operations.h"
#include "test_classes.h"

namespace test
{

using namespace cimserver;

class Fake_Operations : public Operations
{
public:
    std::string last_class;
    bool last_deep = false;
    Property_List last_properties;
    Object_Path last_path;
    std::vector<Instance> instances = {port("1"), port("2")};

    static Instance port(const std::string& name)
    {
        Instance instance;
        instance.path = {"", "root/test", "TST_Port", {{"Name", {CMPI_string, name}}}};
        instance.properties = {{"Name", {CMPI_string, name}}, {"Status", {CMPI_string, {}}}};
        return instance;
    }

    const zmlr::Meta_Class* get_class(const std::string& name_space, const std::string& class_name) override
    {
        if (name_space != "root/test")
            throw Cim_Error(CIM_ERR_INVALID_NAMESPACE, "unknown name space: " + name_space);
        for (const zmlr::Meta_Class* meta_class : {&TST_Element, &TST_Port, &TST_Link})
            if (equal_names(meta_class->name, class_name))
                return meta_class;
        throw Cim_Error(CIM_ERR_NOT_FOUND, "unknown class: " + class_name);
    }

    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string&, const std::string& class_name, bool deep) override
    {
        last_class = class_name;
        last_deep = deep;
        return {&TST_Element, &TST_Link};
    }

    std::vector<Object_Path> enumerate_instance_names(const std::string&, const std::string& class_name) override
    {
        last_class = class_name;
        std::vector<Object_Path> paths;
        for (const Instance& instance : instances)
            paths.push_back(instance.path);
        return paths;
    }

    std::vector<Instance> enumerate_instances(const std::string&, const std::string& class_name, bool deep,
                                              const Property_List& properties) override
    {
        last_class = class_name;
        last_deep = deep;
        last_properties = properties;
        return instances;
    }

    Instance get_instance(const Object_Path& path, const Property_List& properties) override
    {
        last_path = path;
        last_properties = properties;
        return instances.front();
    }

    Method_Result invoke_method(const Object_Path& path, const std::string& method, const std::vector<Named_Value>&) override
    {
        last_path = path;
        throw Cim_Error(CIM_ERR_METHOD_NOT_FOUND, "unknown method: " + method);
    }
};

} // namespace test
