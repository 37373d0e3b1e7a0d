// One call of a provider: the objects that go in, and the sinks that take what comes out.
#pragma once

#include "cimserver/broker/repository.h"
#include "cimserver/broker/request.h"

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

// Which properties an answer shows: those that the client listed and, if a class is named, that it has. Both must outlive
// the selection.
class Selection
{
public:
    Selection(const Property_List& properties, const Property_Layout* named_class)
        : _properties(properties)
        , _named_class(named_class)
    {
    }

    // The flags of a layout's slots; null when all are shown. They hold until the next call with another layout.
    const std::vector<bool>* flags(const std::shared_ptr<const Property_Layout>& layout);

private:
    void hide_others();

    const Property_List& _properties;
    const Property_Layout* _named_class;
    std::shared_ptr<const Property_Layout> _layout; // of the flags
    std::vector<bool> _flags;
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

// Collects instances, less the properties that the selection leaves out. A path that has no name space gets the request's,
// one without keys gets them from the instance.
class Instance_Sink : public Result_Sink
{
public:
    Instance_Sink(std::string name_space, const Property_List& properties, const Property_Layout* named_class)
        : _name_space(std::move(name_space))
        , _selection(properties, named_class)
    {
    }

    void take_instance(const Instance_Object& instance) override;

    std::vector<Instance> found;

private:
    const std::string _name_space;
    Selection _selection;
};

// Keeps what a method returns.
class Data_Sink : public Result_Sink
{
public:
    void take_data(const Value& data) override { value = data; }

    Value value;
};

// Throws the Cim_Error that a provider's status other than OK means.
void check_status(const Class_Entry& provider, const CMPIStatus& status);

// The context, the result and the path of a call; what the provider makes lives as long as this.
class Provider_Call
{
public:
    Provider_Call(const Class_Entry& provider, Object_Path path, Result_Sink& sink, CMPIFlags flags = 0);

    // Calls a function of the provider's table with the interface, the context, the result, the path and the arguments. Throws
    // the Cim_Error that a status other than OK means; CIM_ERR_NOT_SUPPORTED when the table has no such function.
    template <class MI, class Function, class... Arguments> void run(MI* mi, Function function, Arguments... arguments)
    {
        check_offered(function != nullptr);
        check_status(_provider, function(mi, _request.context(), _result, _path, arguments...));
    }

private:
    void check_offered(bool offered) const;

    const Class_Entry& _provider;
    Request _request;
    CMPIResult* _result;
    CMPIObjectPath* _path;
};

} // namespace cimserver
