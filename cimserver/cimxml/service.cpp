#include "cimserver/cimxml/service.h"

#include "cimserver/cimxml/class_writer.h"
#include "cimserver/cimxml/object_reader.h"
#include "cimserver/cimxml/object_writer.h"
#include "cimserver/cimxml/parameters.h"
#include "cimserver/cimxml/qualifier_writer.h"
#include "cimserver/cimxml/request_reader.h"
#include "cimserver/cimxml/response_writer.h"
#include "cimserver/model/names.h"

#include <array>
#include <memory>
#include <new>

namespace cimserver
{
namespace
{

Class_Selection read_class_selection(const Parameters& parameters)
{
    Class_Selection selection;
    selection.local_only = parameters.boolean("LocalOnly", true);
    selection.qualifiers = parameters.boolean("IncludeQualifiers", true);
    selection.class_origin = parameters.boolean("IncludeClassOrigin", false);
    return selection;
}

void get_class(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    Class_Selection selection = read_class_selection(parameters);
    selection.properties = parameters.property_list("PropertyList");
    const std::string class_name = parameters.class_name("ClassName");
    write_class(writer, *name_spaces.at(parameters.name_space(), class_name).get_class(class_name), selection);
}

std::vector<const zmlr::Meta_Class*> wanted_classes(Name_Spaces& name_spaces, const Parameters& parameters)
{
    const std::string class_name = parameters.optional_class_name("ClassName");
    const bool deep = parameters.boolean("DeepInheritance", false);
    return name_spaces.at(parameters.name_space(), class_name).enumerate_classes(class_name, deep);
}

void enumerate_classes(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const Class_Selection selection = read_class_selection(parameters);
    for (const zmlr::Meta_Class* meta_class : wanted_classes(name_spaces, parameters))
        write_class(writer, *meta_class, selection);
}

void enumerate_class_names(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    for (const zmlr::Meta_Class* meta_class : wanted_classes(name_spaces, parameters))
        writer.start("CLASSNAME").attribute("NAME", meta_class->name).end();
}

void get_qualifier(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    name_spaces.at(parameters.name_space(), "");
    const std::string name = parameters.text("QualifierName");
    if (!write_qualifier_declaration(writer, name))
        throw Cim_Error(CIM_ERR_NOT_FOUND, "there is no qualifier " + name);
}

void enumerate_qualifiers(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    name_spaces.at(parameters.name_space(), "");
    write_qualifier_declarations(writer);
}

// A key without a name is the only key of its class.
void name_single_key(Name_Spaces& name_spaces, Object_Path& path)
{
    if (path.keys.size() != 1 || !path.keys.front().name.empty())
        return;
    const zmlr::Meta_Class& meta_class = *name_spaces.at(path).get_class(path.class_name);
    for (unsigned i = 0; meta_class.num_keys == 1 && i < meta_class.num_meta_features; ++i)
        if (zmlr::is_key(meta_class.meta_features[i]))
            path.keys.front().name = meta_class.meta_features[i]->name;
    if (path.keys.front().name.empty())
        throw Cim_Error(CIM_ERR_INVALID_PARAMETER, "unnamed key of a class with several keys: " + path.class_name.string());
}

// The class whose features' origins are written; null when the client does not want them, and for an object of a class or a
// name space that nobody here knows.
const zmlr::Meta_Class* origins_of(Name_Spaces& name_spaces, const Parameters& parameters, const Object_Path& path)
{
    if (!parameters.boolean("IncludeClassOrigin", false))
        return nullptr;
    try
    {
        return name_spaces.at(path).get_class(path.class_name);
    }
    catch (const Cim_Error&)
    {
        return nullptr;
    }
}

Object_Path named_instance(Name_Spaces& name_spaces, const Parameters& parameters)
{
    Object_Path path = parameters.instance_name("InstanceName");
    name_single_key(name_spaces, path);
    return path;
}

void get_instance(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const Property_List properties = parameters.property_list("PropertyList");
    const Object_Path path = named_instance(name_spaces, parameters);
    const Instance instance = name_spaces.at(path).get_instance(path, properties);
    write_instance(writer, instance, origins_of(name_spaces, parameters, instance.path));
}

void enumerate_instances(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string class_name = parameters.class_name("ClassName");
    const bool deep = parameters.boolean("DeepInheritance", true);
    const Property_List properties = parameters.property_list("PropertyList");
    for (const Instance& instance :
         name_spaces.at(parameters.name_space(), class_name).enumerate_instances(class_name, deep, properties))
    {
        writer.start("VALUE.NAMEDINSTANCE");
        write_instance_name(writer, instance.path);
        write_instance(writer, instance, origins_of(name_spaces, parameters, instance.path));
        writer.end();
    }
}

void enumerate_instance_names(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string class_name = parameters.class_name("ClassName");
    for (const Object_Path& path : name_spaces.at(parameters.name_space(), class_name).enumerate_instance_names(class_name))
        write_instance_name(writer, path);
}

void create_instance(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const Instance instance = parameters.instance("NewInstance");
    write_instance_name(writer, name_spaces.at(instance.path).create_instance(instance));
}

void modify_instance(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer&)
{
    Instance instance = parameters.named_instance("ModifiedInstance");
    name_single_key(name_spaces, instance.path);
    name_spaces.at(instance.path).modify_instance(instance, parameters.property_list("PropertyList"));
}

void delete_instance(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer&)
{
    const Object_Path path = named_instance(name_spaces, parameters);
    name_spaces.at(path).delete_instance(path);
}

void get_property(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string property = parameters.text("PropertyName");
    const Object_Path path = named_instance(name_spaces, parameters);
    write_any_value(writer, name_spaces.at(path).get_property(path, property));
}

void set_property(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer&)
{
    const std::string property = parameters.text("PropertyName");
    const Object_Path path = named_instance(name_spaces, parameters);
    name_spaces.at(path).set_property(path, property, parameters.value("NewValue"));
}

// Where a traversal starts and what it is to find. References call the association's class their result class.
struct Traversal
{
    Traversal(Name_Spaces& name_spaces, const Parameters& parameters, bool to_associations)
        : source(parameters.object_name("ObjectName"))
        , operations(name_spaces.at(source))
    {
        name_single_key(name_spaces, source);
        filter.association_class = parameters.optional_class_name(to_associations ? "ResultClass" : "AssocClass");
        filter.role = parameters.optional_text("Role");
        if (to_associations)
            return;
        filter.result_class = parameters.optional_class_name("ResultClass");
        filter.result_role = parameters.optional_text("ResultRole");
    }

    Object_Path source;
    Operations& operations;
    Association_Filter filter;
};

template <bool to_associations> void traverse(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const Traversal asked(name_spaces, parameters, to_associations);
    const Property_List list = parameters.property_list("PropertyList");
    for (const Instance& object : to_associations ? asked.operations.references(asked.source, asked.filter, list)
                                                  : asked.operations.associators(asked.source, asked.filter, list))
        write_object_with_path(writer, object, origins_of(name_spaces, parameters, object.path));
}

template <bool to_associations> void traverse_names(Name_Spaces& name_spaces, const Parameters& parameters, Xml_Writer& writer)
{
    const Traversal asked(name_spaces, parameters, to_associations);
    for (const Object_Path& path : to_associations ? asked.operations.reference_names(asked.source, asked.filter)
                                                   : asked.operations.associator_names(asked.source, asked.filter))
    {
        writer.start("OBJECTPATH");
        write_instance_path(writer, path);
        writer.end();
    }
}

enum class Asks
{
    nobody,
    the_class,    // the providers of ClassName, unless the server itself answers for it
    the_instance, // the same of InstanceName
    providers
};

struct Operation_Row
{
    std::string_view name;
    void (*run)(Name_Spaces&, const Parameters&, Xml_Writer&);
    Asks asks;
    Answer answer;
    std::array<std::string_view, 8> parameters;
};

// LocalOnly and IncludeQualifiers are deprecated for instances: they have no effect.
// clang-format off
constexpr Operation_Row operation_rows[] = {
    {"AssociatorNames",        traverse_names<false>,    Asks::providers,    Answer::value,
        {"ObjectName", "AssocClass", "ResultClass", "Role", "ResultRole"}},
    {"Associators",            traverse<false>,          Asks::providers,    Answer::value,
        {"ObjectName", "AssocClass", "ResultClass", "Role", "ResultRole", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
    {"CreateInstance",         create_instance,          Asks::providers,    Answer::value,
        {"NewInstance"}},
    {"DeleteInstance",         delete_instance,          Asks::providers,    Answer::nothing,
        {"InstanceName"}},
    {"EnumerateClassNames",    enumerate_class_names,    Asks::nobody,       Answer::value,
        {"ClassName", "DeepInheritance"}},
    {"EnumerateClasses",       enumerate_classes,        Asks::nobody,       Answer::value,
        {"ClassName", "DeepInheritance", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin"}},
    {"EnumerateInstanceNames", enumerate_instance_names, Asks::the_class,    Answer::value,
        {"ClassName"}},
    {"EnumerateInstances",     enumerate_instances,      Asks::the_class,    Answer::value,
        {"ClassName", "LocalOnly", "DeepInheritance", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
    {"EnumerateQualifiers",    enumerate_qualifiers,     Asks::nobody,       Answer::value,
        {}},
    {"GetClass",               get_class,                Asks::nobody,       Answer::value,
        {"ClassName", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
    {"GetInstance",            get_instance,             Asks::the_instance, Answer::value,
        {"InstanceName", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
    {"GetProperty",            get_property,             Asks::the_instance, Answer::value,
        {"InstanceName", "PropertyName"}},
    {"GetQualifier",           get_qualifier,            Asks::nobody,       Answer::value,
        {"QualifierName"}},
    {"ModifyInstance",         modify_instance,          Asks::providers,    Answer::nothing,
        {"ModifiedInstance", "IncludeQualifiers", "PropertyList"}},
    {"ReferenceNames",         traverse_names<true>,     Asks::providers,    Answer::value,
        {"ObjectName", "ResultClass", "Role"}},
    {"References",             traverse<true>,           Asks::providers,    Answer::value,
        {"ObjectName", "ResultClass", "Role", "IncludeQualifiers", "IncludeClassOrigin", "PropertyList"}},
    {"SetProperty",            set_property,             Asks::providers,    Answer::nothing,
        {"InstanceName", "PropertyName", "NewValue"}},
};
// clang-format on

const Operation_Row& row_of(const std::string& method)
{
    if (const Operation_Row* row = find_named(operation_rows, method))
        return *row;
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, "operation not supported: " + method);
}

bool may_take_long(Name_Spaces& name_spaces, const Operation_Row& row, const Parameters& parameters)
{
    switch (row.asks)
    {
    case Asks::nobody:
        return false;
    case Asks::the_class:
        return name_spaces.at(parameters.name_space(), parameters.class_name("ClassName")).asks_providers();
    case Asks::the_instance:
        return name_spaces.at(parameters.instance_name("InstanceName")).asks_providers();
    case Asks::providers:
        break;
    }
    return true;
}

std::string run_operation(Name_Spaces& name_spaces, const Operation_Row& row, const Parameters& parameters,
                          const Cimxml_Request& request)
{
    return write_success(request, row.answer, [&](Xml_Writer& writer) { row.run(name_spaces, parameters, writer); });
}

std::string call_method(Name_Spaces& name_spaces, const Cimxml_Request& request)
{
    Object_Path target = read_path(target_of(request), "");
    name_single_key(name_spaces, target);
    const std::vector<Named_Value> in = read_arguments(request, target.name_space);
    return write_method_result(request, name_spaces.at(target).invoke_method(target, request.method, in));
}

// The answer that the work gives, or the error that it throws.
template <class Work> Http_Answer answer(const Cimxml_Request& request, Work work)
{
    try
    {
        return {200, "", work()};
    }
    catch (const Cim_Error& error)
    {
        return {200, "", write_error(request, error)};
    }
    catch (const std::bad_alloc&)
    {
        throw;
    }
    catch (const std::exception& error)
    {
        return {200, "", write_error(request, Cim_Error(CIM_ERR_FAILED, error.what()))};
    }
}

Http_Work handle_operation(Name_Spaces& name_spaces, const std::shared_ptr<const Cimxml_Request>& request)
{
    Http_Work result;
    const auto work = [&]
    {
        const Operation_Row& row = row_of(request->method);
        const Parameters parameters(*request, row.parameters);
        for (std::string_view flag : {"LocalOnly", "DeepInheritance", "IncludeQualifiers", "IncludeClassOrigin"})
            parameters.boolean(flag, false); // refused when it is none, also where it has no effect
        if (!may_take_long(name_spaces, row, parameters))
            return run_operation(name_spaces, row, parameters, *request);
        result.rest = [&name_spaces, &row, parameters, request]
        { return answer(*request, [&] { return run_operation(name_spaces, row, parameters, *request); }); };
        return std::string();
    };
    result.answer = answer(*request, work);
    return result;
}

} // namespace

Http_Work Service::handle(const Http_Request& http_request)
{
    try
    {
        if (!equal_names(http_request.cim_operation, "MethodCall"))
            throw Http_Refusal(400, "unsupported-operation");
        const auto request = std::make_shared<const Cimxml_Request>(read_request(http_request.body));
        if (request->intrinsic)
            return handle_operation(_name_spaces, request);
        const auto call = [&name_spaces = _name_spaces, request] { return call_method(name_spaces, *request); };
        return {{}, [request, call] { return answer(*request, call); }};
    }
    catch (const Http_Refusal& refusal)
    {
        return {{refusal.status(), refusal.cim_error(), ""}, {}};
    }
}

} // namespace cimserver
