// Module_Operations: the CIM operations answered from a provider module, in the name space "root/zemlar".
//
// Class operations read the module's meta-data. Instance operations ask the providers: a class that is served, and every
// served class derived from the one that was named, in the order of their registration; each is asked with its own class
// name. A class that exists and that nothing serves answers empty. When one provider fails, the operation fails with its
// error (an answer that silently lacks a provider's instances would be taken for the whole truth).
//
// CMPI return codes become CIM status codes; the description names the provider, the code and the provider's message.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/operations.h"

#include <optional>
#include <string>
#include <vector>

namespace cimserver
{

class Module_Operations : public Operations
{
public:
    static constexpr const char* served_name_space = "root/zemlar";

    // From now on this object answers the module's up-calls, unless its broker is told otherwise. The destructor closes the
    // module, which must outlive this object.
    explicit Module_Operations(Module& module);
    ~Module_Operations() override;

    const zmlr::Meta_Class* get_class(const std::string& name_space, const std::string& class_name) override;
    std::vector<const zmlr::Meta_Class*> enumerate_classes(const std::string& name_space, const std::string& class_name,
                                                           bool deep_inheritance) override;
    std::vector<Object_Path> enumerate_instance_names(const std::string& name_space, const std::string& class_name) override;
    std::vector<Instance> enumerate_instances(const std::string& name_space, const std::string& class_name, bool deep_inheritance,
                                              const Property_List& properties) override;
    Instance get_instance(const Object_Path& path, const Property_List& properties) override;
    void invoke_method(const Object_Path& path, const std::string& method) override;

private:
    const Class_Entry& known_class(const std::string& name_space, const std::string& class_name) const;
    std::optional<Instance> find_instance(const Class_Entry& provider, std::vector<Named_Value> keys,
                                          const Property_List& properties);

    Module& _module;
};

} // namespace cimserver
