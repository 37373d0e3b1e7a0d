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

// The class whose features' origins are written, null when the client does not want them.
const zmlr::Meta_Class* origins_of(Operations& operations, const Parameters& parameters, const std::string& class_name)
{
    return parameters.boolean("IncludeClassOrigin", false) ? operations.get_class(parameters.name_space(), class_name) : nullptr;
}

void get_instance(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const Property_List properties = parameters.property_list("PropertyList");
    Object_Path path = parameters.instance_name("InstanceName");
    name_single_key(operations, path);
    const Instance instance = operations.get_instance(path, properties);
    write_instance(writer, instance, origins_of(operations, parameters, instance.path.class_name));
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
        write_instance(writer, instance, origins_of(operations, parameters, instance.path.class_name));
        writer.end();
    }
}

void enumerate_instance_names(Operations& operations, const Parameters& parameters, Xml_Writer& writer)
{
    const std::string class_name = parameters.class_name("ClassName");
    for (const Object_Path& path : operations.enumerate_instance_names(parameters.name_space(), class_name))
        write_instance_name(writer, path);
}

struct Operation_Row
{
    std::string_view name;
    void (*run)(Operations&, const Parameters&, Xml_Writer&);
    std::array<std::string_view, 6> parameters;
};

// LocalOnly and IncludeQualifiers are deprecated for instances: accepted, checked by no one, without effect.
// clang-format off
constexpr Operation_Row operation_rows[] = {
    {"EnumerateClassNames",    enumerate_class_names,    {"ClassName", "DeepInheritance"}},
    {"EnumerateClasses",       enumerate_classes,        {"ClassName", "DeepInheritance", "LocalOnly", "IncludeQualifiers",
                                                          "IncludeClassOrigin"}},
    {"EnumerateInstanceNames", enumerate_instance_names, {"ClassName"}},
    {"EnumerateInstances",     enumerate_instances,      {"ClassName", "LocalOnly", "DeepInheritance", "IncludeQualifiers",
                                                          "IncludeClassOrigin", "PropertyList"}},
    {"GetClass",               get_class,                {"ClassName", "LocalOnly", "IncludeQualifiers", "IncludeClassOrigin",
                                                          "PropertyList"}},
    {"GetInstance",            get_instance,             {"InstanceName", "LocalOnly", "IncludeQualifiers",
                                                          "IncludeClassOrigin", "PropertyList"}},
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
    return write_success(request, [&](Xml_Writer& writer) { row.run(operations, parameters, writer); });
}

std::string call_method(Operations& operations, const Cimxml_Request& request)
{
    operations.invoke_method(read_path(target_of(request), ""), request.method);
    throw Cim_Error(CIM_ERR_METHOD_NOT_AVAILABLE, "method not available: " + request.method);
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
