// The object types that a broker hands to providers, each a CMPI handle around the server's own model.
//
// The members here work on the model and throw Failure; the function tables behind the handles are shells around them.
#pragma once

#include "cimserver/broker/object.h"
#include "cimserver/model/repository.h"
#include "cimserver/model/values.h"

#include <memory>
#include <string>
#include <vector>

namespace cimserver
{

// A text; any bytes but zero, passed on as they are.
class String_Object : public Handle<CMPIString, String_Object>
{
public:
    static const Table table;

    explicit String_Object(Text text_) : text(std::move(text_)) {}

    const Text text;
};

// An array of fixed size. Elements start null; a text array takes CMPI_chars too.
class Array_Object : public Handle<CMPIArray, Array_Object>
{
public:
    static const Table table;
    static constexpr CMPICount max_size = 1'000'000;

    // Throws INVALID_DATA_TYPE unless the type is a scalar's, INVALID_PARAMETER above max_size.
    Array_Object(CMPICount size, CMPIType element_type_);
    Array_Object(CMPIType element_type_, std::vector<Value> elements_);

    const CMPIType element_type;
    std::vector<Value> elements;
};

class Datetime_Object : public Handle<CMPIDateTime, Datetime_Object>
{
public:
    static const Table table;

    explicit Datetime_Object(Text text_); // throws INVALID_PARAMETER when the text is no datetime

    const Text text;
};

class Path_Object : public Handle<CMPIObjectPath, Path_Object>
{
public:
    static const Table table;

    // The keys that are added share the names of the class, if one is given.
    explicit Path_Object(Object_Path path_, const Class_Entry* entry = nullptr) : path(std::move(path_)), class_entry(entry) {}

    Object_Path path;
    const Class_Entry* class_entry;
};

// An instance of a class: the properties of its layout, all null at first.
class Instance_Object : public Handle<CMPIInstance, Instance_Object>
{
public:
    static const Table table;

    Instance_Object(std::shared_ptr<const Property_Layout> layout, Object_Path path_);
    explicit Instance_Object(const Instance& instance);

    const Property_Layout& layout() const { return *_layout; }
    const std::shared_ptr<const Property_Layout>& shared_layout() const { return _layout; }

    // Whether the property filter leaves a place in view.
    bool visible(std::size_t place) const { return !_filter || (*_filter)[place]; }
    const Value& value(std::size_t place) const { return _properties[place]; } // a null value has the property's type

    // Throws NO_SUCH_PROPERTY, or TYPE_MISMATCH unless the value has the property's type (or none). A property that the
    // filter hides stays as it is.
    void set(std::string_view name, Value value);

    // From now on only the listed properties and the keys are in view. Null: all properties are.
    void filter(const char** properties, const char** keys);

    // The instance as clients see it: the visible places, less those that `selection` (unless null) leaves out.
    Instance model(const std::vector<bool>* selection = nullptr) const;

    Object_Path path;

private:
    std::shared_ptr<const Property_Layout> _layout;
    Properties _properties;
    Shared<std::vector<bool>> _filter; // unless all are in view
};

class Args_Object : public Handle<CMPIArgs, Args_Object>
{
public:
    static const Table table;

    std::vector<Named_Value> args;
};

// The circumstances of a request: its flags, the user it is for.
class Context_Object : public Handle<CMPIContext, Context_Object>
{
public:
    static const Table table;

    std::vector<Named_Value> entries;
};

// Takes what a provider answers to one request; each member throws NOT_SUPPORTED unless the request can have such an answer.
class Result_Sink
{
public:
    virtual ~Result_Sink() = default;
    virtual void take_instance(const Instance_Object&) { throw Failure{CMPI_RC_ERR_NOT_SUPPORTED}; }
    virtual void take_path(const Object_Path&) { throw Failure{CMPI_RC_ERR_NOT_SUPPORTED}; }
    virtual void take_data(const Value&) { throw Failure{CMPI_RC_ERR_NOT_SUPPORTED}; }
};

class Result_Object : public Handle<CMPIResult, Result_Object>
{
public:
    static const Table table;

    explicit Result_Object(Result_Sink& sink_) : sink(sink_) {}

    Result_Sink& sink;
};

// What an up-call answers: instances or paths, handed out one by one.
class Enumeration_Object : public Handle<CMPIEnumeration, Enumeration_Object>
{
public:
    static const Table table;

    explicit Enumeration_Object(std::vector<Value> elements_) : elements(std::move(elements_)) {}

    std::vector<Value> elements;
    std::size_t next = 0;
};

// The query of an indication filter, which the server evaluates itself.
class Select_Object : public Handle<CMPISelectExp, Select_Object>
{
public:
    static const Table table;

    explicit Select_Object(Text query_) : query(std::move(query_)) {}

    const Text query;
};

} // namespace cimserver
