// Own_Operations: the operations on the server's own classes (server_schema.h), which Server_Class objects answer.
#pragma once

#include "cimserver/interop/server_class.h"
#include "cimserver/model/operations.h"
#include "cimserver/model/repository.h"
#include "cimserver/operations/association_routing.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace cimserver
{

class Own_Operations : public Operations
{
public:
    static constexpr const char* name_space = "root/PG_InterOp";
    static constexpr const char* names[] = {name_space, "root/interop", "interop"}; // that clients try
    static bool is_name(std::string_view name);

    // The filter of a traversal may also name classes of the module.
    explicit Own_Operations(const Repository& module_classes); // which must outlive it

    // From now on these functions answer for their class. Before the first request; throws std::logic_error for a class that is
    // not of the server's schema or has an answer already. A class of the schema that nobody answers has no instances.
    void serve(Server_Class server_class);

    const Repository& classes() const { return _repository; }

    bool asks_providers() const override { return false; }
    const zmlr::Meta_Class* get_class(const std::string& class_name) override;
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& class_name, bool deep_inheritance) override;
    std::vector<Object_Path> enumerate_instance_names(const std::string& class_name) override;
    std::vector<Instance> enumerate_instances(const std::string& class_name, bool deep_inheritance,
                                              const Property_List& properties) override;
    Instance get_instance(const Object_Path& path, const Property_List& properties) override;
    Object_Path create_instance(const Instance& instance) override;
    void modify_instance(const Instance& instance, const Property_List& properties) override;
    void delete_instance(const Object_Path& path) override;
    std::vector<Instance> associators(const Object_Path& path, const Association_Filter& filter,
                                      const Property_List& properties) override;
    std::vector<Object_Path> associator_names(const Object_Path& path, const Association_Filter& filter) override;
    std::vector<Instance> references(const Object_Path& path, const Association_Filter& filter,
                                     const Property_List& properties) override;
    std::vector<Object_Path> reference_names(const Object_Path& path, const Association_Filter& filter) override;
    Method_Result invoke_method(const Object_Path& path, const std::string& method, const std::vector<Named_Value>& in) override;

private:
    struct Found
    {
        const Class_Entry& entry;
        const Server_Class& server_class;
        Object_Path path; // its typed keys
        Instance instance;
    };
    struct Reference
    {
        const Class_Entry& entry;
        Instance association;
        std::string near; // the reference that names the source
    };

    const Server_Class* answering(const Class_Entry& entry) const; // null when nobody does
    Found find(const Object_Path& path) const;
    std::vector<Named_Value> keys_of(const Class_Entry& entry, const Object_Path& path) const; // typed

    // The instance as every client sees it: all properties of its class in their order, less those that are not asked for.
    static Instance shown(Instance instance, const Class_Entry& entry, const Property_List& properties);

    bool admits(const Association_Filter& filter) const;
    std::vector<Reference> find_references(const Object_Path& path, const Association_Filter& filter, Ends ends) const;

    const Repository& _module_classes;
    const Repository _repository;
    std::unordered_map<const Class_Entry*, Server_Class> _server_classes;
};

} // namespace cimserver
