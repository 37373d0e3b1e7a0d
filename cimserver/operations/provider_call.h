// One call of a provider: the objects that go in, and the sinks that take what comes out.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/broker/request.h"
#include "cimserver/model/repository.h"

#include <memory>
#include <string>
#include <vector>

namespace cimserver
{

// A property list as a provider takes it, less the names that a class has not, if one is given. No list is a null pointer. The
// texts are those of the list, which must outlive it.
class Name_List
{
public:
    explicit Name_List(const Property_List& properties, const Property_Layout* layout = nullptr);

    const char** names() { return _absent ? nullptr : _names.data(); }

private:
    bool _absent;
    std::vector<const char*> _names;
};

// Collects the paths of an enumeration of names. A path that has no name space gets the request's.
class Path_Sink : public Result_Sink
{
public:
    explicit Path_Sink(std::string name_space) : _name_space(std::move(name_space)) {}

    void take_path(const Object_Path& path) override;

    std::vector<Object_Path> found;

private:
    const std::string _name_space;
};

// Collects instances with the listed properties, without a list with all. A path that has no name space gets the request's, one
// without keys gets them from the instance.
class Instance_Sink : public Result_Sink
{
public:
    Instance_Sink(std::string name_space, Property_List shown) : _name_space(std::move(name_space)), _shown(std::move(shown)) {}
    void take_instance(const Instance_Object& instance) override;

    std::vector<Instance> found;

private:
    const std::string _name_space;
    const Property_List _shown;
    std::shared_ptr<const Property_Layout> _layout; // of the last instance
    std::vector<bool> _flags;                       // of its places
};

// Keeps what a method returns.
class Data_Sink : public Result_Sink
{
public:
    void take_data(const Value& data) override { value = data; }

    Value value;
};

// Throws the Cim_Error that a provider's status other than OK means; the action is what it was asked for, as people call it.
void check_status(const Class_Entry& provider, const char* action, const CMPIStatus& status);

// Throws CIM_ERR_NOT_SUPPORTED when a provider's table has no function for the action.
void check_offered(const Class_Entry& provider, const char* action, bool offered);

// The context, the result and the path of a call; what the provider makes lives as long as this.
class Provider_Call
{
public:
    Provider_Call(Module& module, const Class_Entry& provider, const char* action, Object_Path path, Result_Sink& sink,
                  CMPIFlags flags = 0);

    // Waits for a turn with the provider, and calls a function of its table with the interface, the context, the result, the path
    // and the arguments. Throws the Cim_Error that a status other than OK means; CIM_ERR_NOT_SUPPORTED when the table has no such
    // function.
    template <class MI, class Function, class... Arguments> void run(MI* mi, Function function, Arguments... arguments)
    {
        check_offered(_provider, _action, function != nullptr);
        const Provider_Turn turn(_module.turns(_provider), _provider.meta_class->name);
        check_status(_provider, _action, function(mi, _request.context(), _result, _path, arguments...));
    }

private:
    Module& _module;
    const Class_Entry& _provider;
    const char* const _action; // a literal or a method's name
    Request _request;
    CMPIResult* _result;
    CMPIObjectPath* _path;
};

} // namespace cimserver
