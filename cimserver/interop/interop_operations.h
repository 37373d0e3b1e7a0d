// Interop_Operations: the interop name space "root/PG_InterOp", where clients discover the server and manage subscriptions.
//
// Its classes are the server's own (server_schema.h), answered by Server_Class objects, and those of the module that clients
// look for there: the registered profiles and what ties them to elements. A class of the server's is never answered by the
// module: an enumeration of CIM_ObjectManager here does not come back to a subclass of the module's.
#pragma once

#include "cimserver/broker/repository.h"
#include "cimserver/interop/server_class.h"
#include "cimserver/module_operations.h"
#include "cimserver/operations.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

namespace cimserver
{

class Interop_Operations : public Operations
{
public:
    static constexpr const char* name_space = "root/PG_InterOp";

    explicit Interop_Operations(Module& module); // which must outlive it

    // From now on the object answers its class. Before the first request; throws std::logic_error for a class that is not
    // of the server's schema or has an answer already. A class of the schema that nobody answers has no instances.
    void serve(std::unique_ptr<Server_Class> server_class);

    const zmlr::Meta_Class* get_class(const std::string& name_space, const std::string& class_name) override;
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& name_space, const std::string& class_name,
                                                           bool deep_inheritance) override;
    std::vector<Object_Path> enumerate_instance_names(const std::string& name_space, const std::string& class_name) override;
    std::vector<Instance> enumerate_instances(const std::string& name_space, const std::string& class_name, bool deep_inheritance,
                                              const Property_List& properties) override;
    Instance get_instance(const Object_Path& path, const Property_List& properties) override;
    Object_Path create_instance(const Instance& instance) override;
    void modify_instance(const Instance& instance, const Property_List& properties) override;
    void delete_instance(const Object_Path& path) override;
    std::vector<Instance> exec_query(const std::string& name_space, const std::string& query,
                                     const std::string& language) override;
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
        Server_Class& server_class;
        Object_Path path; // its typed keys
        Instance instance;
    };
    struct Own_Reference
    {
        const Class_Entry& entry;
        Instance association;
        std::string near; // the reference that names the source
    };

    bool is_own(const std::string& class_name) const;        // of an instance, which needs keys
    Server_Class* answering(const Class_Entry& entry) const; // null when nobody does
    Server_Class& changing(const Class_Entry& entry) const;  // CIM_ERR_NOT_SUPPORTED when nobody does
    Found find_own(const Class_Entry& named, const Object_Path& path) const;

    // The instance as every client sees it: all properties of its class in their order, less those that are not asked for.
    static Instance shown(Instance instance, const Class_Entry& entry, const Property_List& properties,
                          const Property_Layout* named_class);
    std::vector<Instance> own_instances(const Class_Entry& named, const Property_List& properties,
                                        const Property_Layout* shown_class) const;

    bool admits_own(const Association_Filter& filter) const;
    std::vector<Own_Reference> own_references(const Object_Path& path, const Association_Filter& filter, Ends ends) const;
    std::vector<Object_Path> own_associators(const Object_Path& path, const Association_Filter& filter) const;

    const Repository _own;
    const Class_View _classes; // of the server's own
    Module_Operations _module_part;
    std::unordered_map<const Class_Entry*, std::unique_ptr<Server_Class>> _server_classes;
};

} // namespace cimserver
