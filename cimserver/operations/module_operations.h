// Module_Operations: the CIM operations answered from a provider module, in one name space.
//
// Class operations read the module's meta-data. Instance operations ask the providers: a class that is served, and every
// served class derived from the one that was named, in the order of their registration; each is asked with its own class
// name. A class that exists and that nothing serves answers empty. When one provider fails, the operation fails with its
// error (an answer that silently lacks a provider's instances would be taken for the whole truth).
//
// Changes and methods go to the one provider that has the instance: that of the class named in the path, or when nothing
// serves that class, of the served subclass that answers get_instance. Association requests go to every association class that
// can concern the source (association_routing.h).
//
// CMPI return codes become CIM status codes; the description names the provider, the code and the provider's message.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/broker/objects.h"
#include "cimserver/model/operations.h"
#include "cimserver/model/repository.h"
#include "cimserver/operations/association_routing.h"

#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace cimserver
{

class Module_Operations : public Operations
{
public:
    static constexpr const char* served_name_space = "root/zemlar";

    // All classes of the module, in "root/zemlar". The module must outlive this object.
    explicit Module_Operations(Module& module);

    // In another name space, the served classes that are one of `roots` or derive from one.
    Module_Operations(Module& module, std::string name_space, std::span<const std::string_view> roots);

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

    const Repository& classes() const { return _classes; }

private:
    // The provider that has an instance, and its path as that provider takes it.
    struct Target
    {
        const Class_Entry& provider;
        Object_Path path;
    };

    Object_Path path_to(const Class_Entry& entry, std::vector<Named_Value> keys = {}) const;
    std::optional<Instance> find_instance(const Class_Entry& provider, std::vector<Named_Value> keys,
                                          const Property_List& properties);
    Target target_of(const Object_Path& path);
    std::optional<Object_Path> source_of(const Class_Entry& named, const Object_Path& path);
    const Class_Entry* method_provider(const Class_Entry& named, const Object_Path& path);

    template <class Sink, class Function, class... Words>
    auto traverse(const Object_Path& path, const Association_Filter& filter, Ends ends, Sink sink,
                  Function CMPIAssociationMIFT::*function, Words... words);

    Module& _module;
    const std::string _name_space;
    const std::optional<Repository> _part; // none: all classes
    const Repository& _classes;
};

} // namespace cimserver
