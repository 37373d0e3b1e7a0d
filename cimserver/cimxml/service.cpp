#include "cimserver/cimxml/service.h"

#include "cimserver/broker/names.h"
#include "cimserver/cimxml/class_writer.h"
#include "cimserver/cimxml/object_reader.h"
#include "cimserver/cimxml/object_writer.h"
#include "cimserver/cimxml/parameters.h"
#include "cimserver/cimxml/request_reader.h"
#include "cimserver/cimxml/response_writer.h"

#include <array>
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

void get_class(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    Class_Selection selection = read_class_selection(parameters);
    selection.properties = parameters.property_list("PropertyList");
    const std::string class_name = parameters.class_name("ClassName");
    write_class(writer, *operations.get_class(parameters.name_space(), class_name), selection);
}

void enumerate_classes(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Class_Selection selection = read_class_selection(parameters);
    const std::string class_name = parameters.optional_class_name("ClassName");
    const bool deep = parameters.boolean("DeepInheritance", false);
    for (const zmlr::Meta_Class* meta_class : operations.enumerate_classes(parameters.name_space(), class_name, deep))
        write_class(writer, *meta_class, selection);
}

void enumerate_class_names(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string class_name = parameters.optional_class_name("ClassName");
    const bool deep = parameters.boolean("DeepInheritance", false);
    for (const zmlr::Meta_Class* meta_class : operations.enumerate_classes(parameters.name_space(), class_name, deep))
        writer.start("CLASSNAME").attribute("NAME", meta_class->name).end();
}

// A key without a name is the only key of its class.
void name_single_key(Operations& operations, Object_Path& path)
{
    if (path.keys.size() != 1 || !path.keys.front().name.empty())
        return;
    const zmlr::Meta_Class& meta_class = *operations.get_class(path.name_space, path.class_name);
    for (unsigned i = 0; meta_class.num_keys == 1 && i < meta_class.num_meta_features; ++i)
        if (zmlr::is_key(meta_class.meta_features[i]))
            path.keys.front().name = meta_class.meta_features[i]->name;
    if (path.keys.front().name.empty())
        throw Cim_Error(CIM_ERR_INVALID_PARAMETER, "unnamed key of a class with several keys: " + path.class_name);
}

// The class whose features' origins are written; null when the client does not want them, and for an object of a class or a
// name space that nobody here knows.
const zmlr::Meta_Class* origins_of(Operations& operations, const Parameters& parameters, const Object_Path& path)
{
    if (!parameters.boolean("IncludeClassOrigin", false))
        return nullptr;
    try
    {
        return operations.get_class(path.name_space, path.class_name);
    }
    catch (const Cim_Error&)
    {
        return nullptr;
    }
}

Object_Path named_instance(Operations& operations, const Parameters& parameters)
{
    Object_Path path = parameters.instance_name("InstanceName");
    name_single_key(operations, path);
    return path;
}

void get_instance(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Property_List properties = parameters.property_list("PropertyList");
    const Instance instance = operations.get_instance(named_instance(operations, parameters), properties);
    write_instance(writer, instance, origins_of(operations, parameters, instance.path));
}

void enumerate_instances(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string class_name = parameters.class_name("ClassName");
    const bool deep = parameters.boolean("DeepInheritance", true);
    const Property_List properties = parameters.property_list("PropertyList");
    for (const Instance& instance : operations.enumerate_instances(parameters.name_space(), class_name, deep, properties))
    {
        writer.start("VALUE.NAMEDINSTANCE");
        write_instance_name(writer, instance.path);
        write_instance(writer, instance, origins_of(operations, parameters, instance.path));
        writer.end();
    }
}

void enumerate_instance_names(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string class_name = parameters.class_name("ClassName");
    for (const Object_Path& path : operations.enumerate_instance_names(parameters.name_space(), class_name))
        write_instance_name(writer, path);
}

void create_instance(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    write_instance_name(writer, operations.create_instance(parameters.instance("NewInstance")));
}

void modify_instance(Operations& operations, const Parameters& parameters, Xml_Writer&)
{
    Instance instance = parameters.named_instance("ModifiedInstance");
    name_single_key(operations, instance.path);
    operations.modify_instance(instance, parameters.property_list("PropertyList"));
}

void delete_instance(Operations& operations, const Parameters& parameters, Xml_Writer&)
{
    operations.delete_instance(named_instance(operations, parameters));
}

void get_property(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string property = parameters.text("PropertyName");
    write_any_value(writer, operations.get_property(named_instance(operations, parameters), property));
}

void set_property(Operations& operations, const Parameters& parameters, Xml_Writer&)
{
    const std::string property = parameters.text("PropertyName");
    operations.set_property(named_instance(operations, parameters), property, parameters.value("NewValue"));
}

void exec_query(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string query = parameters.text("Query");
    const std::string language = parameters.text("QueryLanguage");
    for (const Instance& instance : operations.exec_query(parameters.name_space(), query, language))
        write_object_with_path(writer, instance, nullptr);
}

// Where a traversal starts and what it is to find. References call the association's class their result class.
struct Traversal
{
    Traversal(Operations& operations, const Parameters& parameters, bool to_associations)
        : source(parameters.object_name("ObjectName"))
    {
        name_single_key(operations, source);
        filter.association_class = parameters.optional_class_name(to_associations ? "ResultClass" : "AssocClass");
        filter.role = parameters.optional_text("Role");
        if (to_associations)
            return;
        filter.result_class = parameters.optional_class_name("ResultClass");
        filter.result_role = parameters.optional_text("ResultRole");
    }

    Object_Path source;
    Association_Filter filter;
};

void write_objects(Operations& operations, const Parameters& parameters, Xml_Writer& writer, const std::vector<Instance>& objects)
{
    for (const Instance& object : objects)
        write_object_with_path(writer, object, origins_of(operations, parameters, object.path));
}

void write_paths(Xml_Writer& writer, const std::vector<Object_Path>& paths)
{
    for (const Object_Path& path : paths)
    {
        writer.start("OBJECTPATH");
        write_instance_path(writer, path);
        writer.end();
    }
}

void associators(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Traversal asked(operations, parameters, false);
    write_objects(operations, parameters, writer,
                  operations.associators(asked.source, asked.filter, parameters.property_list("PropertyList")));
}

void associator_names(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Traversal asked(operations, parameters, false);
    write_paths(writer, operations.associator_names(asked.source, asked.filter));
}

void references(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Traversal asked(operations, parameters, true);
    write_objects(operations, parameters, writer,
                  operations.references(asked.source, asked.filter, parameters.property_list("PropertyList")));
}

void reference_names(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Traversal asked(operations, parameters, true);
    write_paths(writer, operations.reference_names(asked.source, asked.filter));
}

enum class Answer
{
    value,  // an IRETURNVALUE, perhaps empty
    nothing // no IRETURNVALUE at all
};

struct Operation_Row
{
    std::string_view name;
    void (*run)(Operations&, const Parameters&, Xml_Writer&);
    Answer answer;
    std::array<std::string_view, 8> parameters;
};

// LocalOnly and IncludeQualifiers are deprecated for instances: they have no effect.
// clang-format off
constexpr Operation_Row operation_rows[] = {
    {"AssociatorNames",        associator_names,         Answer::value,   {"ObjectName", "AssocClass", "ResultClass", "Role",
                                                                           "ResultRole"}},
    {"Associators",            associators,              Answer::value,   {"ObjectName", "AssocClass", "ResultClass", "Role",
                                                                           "ResultRole", "IncludeQualifiers",
                                                                           "IncludeClassOrigin", "PropertyList"}},
    {"CreateInstance",         create_instance,          Answer::value,   {"NewInstance"}},
    {"DeleteInstance",         delete_instance,          Answer::nothing, {"InstanceName"}},
    {"EnumerateClassNames",    enumerate_class_names,    Answer::value,   {"ClassName", "DeepInheritance"}},
    {"EnumerateClasses",       enumerate_classes,        Answer::value,   {"ClassName", "DeepInheritance", "LocalOnly",
                                                                           "IncludeQualifiers", "IncludeClassOrigin"}},
    {"EnumerateInstanceNames", enumerate_instance_names, Answer::value,   {"ClassName"}},
    {"EnumerateInstances",     enumerate_instances,      Answer::value,   {"ClassName", "LocalOnly", "DeepInheritance",
                                                                           "IncludeQualifiers", "IncludeClassOrigin",
                                                                           "PropertyList"}},
    {"ExecQuery",              exec_query,               Answer::value,   {"QueryLanguage", "Query"}},
    {"GetClass",               get_class,                Answer::value,   {"ClassName", "LocalOnly", "IncludeQualifiers",
                                                                           "IncludeClassOrigin", "PropertyList"}},
    {"GetInstance",            get_instance,             Answer::value,   {"InstanceName", "LocalOnly", "IncludeQualifiers",
                                                                           "IncludeClassOrigin", "PropertyList"}},
    {"GetProperty",            get_property,             Answer::value,   {"InstanceName", "PropertyName"}},
    {"ModifyInstance",         modify_instance,          Answer::nothing, {"ModifiedInstance", "IncludeQualifiers",
                                                                           "PropertyList"}},
    {"ReferenceNames",         reference_names,          Answer::value,   {"ObjectName", "ResultClass", "Role"}},
    {"References",             references,               Answer::value,   {"ObjectName", "ResultClass", "Role",
                                                                           "IncludeQualifiers", "IncludeClassOrigin",
                                                                           "PropertyList"}},
    {"SetProperty",            set_property,             Answer::nothing, {"InstanceName", "PropertyName", "NewValue"}},
};
// clang-format on

const Operation_Row& row_of(const std::string& method)
{
    for (const Operation_Row& row : operation_rows)
        if (equal_names(row.name, method))
            return row;
    throw Cim_Error(CIM_ERR_NOT_SUPPORTED, "operation not supported: " + method);
}

std::string run_operation(Operations& operations, const Cimxml_Request& request)
{
    const Operation_Row& row = row_of(request.method);
    const Parameters parameters(request, row.parameters);
    for (std::string_view flag : {"LocalOnly", "DeepInheritance", "IncludeQualifiers", "IncludeClassOrigin"})
        parameters.boolean(flag, false); // refused when it is none, also where it has no effect
    const auto run = [&](Xml_Writer& writer) { row.run(operations, parameters, writer); };
    return row.answer == Answer::value ? write_success(request, run) : write_empty_success(request, run);
}

std::string call_method(Operations& operations, const Cimxml_Request& request)
{
    Object_Path target = read_path(target_of(request), "");
    name_single_key(operations, target);
    const std::vector<Named_Value> in = read_arguments(request, target.name_space);
    return write_method_result(request, operations.invoke_method(target, request.method, in));
}

std::string run(Operations& operations, const Cimxml_Request& request)
{
    try
    {
        return request.intrinsic ? run_operation(operations, request) : call_method(operations, request);
    }
    catch (const Cim_Error& error)
    {
        return write_error(request, error);
    }
    catch (const std::bad_alloc&)
    {
        throw;
    }
    catch (const std::exception& error)
    {
        return write_error(request, Cim_Error(CIM_ERR_FAILED, error.what()));
    }
}

} // namespace

Http_Answer Service::answer(const Http_Request& request)
{
    try
    {
        if (!request.cim_operation.empty() && !equal_names(request.cim_operation, "MethodCall"))
            throw Http_Refusal(400, "unsupported-operation");
        return {200, "", run(_operations, read_request(request.body))};
    }
    catch (const Http_Refusal& refusal)
    {
        return {refusal.status(), refusal.cim_error(), ""};
    }
}

} // namespace cimserver
