// Association traversal: every association provider that can concern the source is asked, with its own class name.
#include "cimserver/operations/module_operations.h"

#include "cimserver/model/paths.h"
#include "cimserver/operations/provider_call.h"
#include "cimserver/operations/typed_keys.h"

namespace cimserver
{
namespace
{

// A word of the client's as a provider takes it: none is a null pointer.
const char* word(const std::string& text) { return text.empty() ? nullptr : text.c_str(); }

} // namespace

// A source named by a superclass is looked up: only its own path means something to a provider. Nothing when it does not exist.
std::optional<Object_Path> Module_Operations::source_of(const Class_Entry& named, const Object_Path& path)
try
{
    Object_Path source = path_to(named, typed_keys(_module.repository(), named, path));
    return named.registration || _classes.served(named).empty() ? source : get_instance(path, std::vector<std::string>()).path;
}
catch (const Cim_Error& error)
{
    if (error.code() != CIM_ERR_NOT_FOUND)
        throw;
    return std::nullopt;
}

// Asks each provider through a function of its table, with the name of its own class and the words. What is found, each object
// once.
template <class Sink, class Function, class... Words>
auto Module_Operations::traverse(const Object_Path& path, const Association_Filter& filter, Ends ends, Sink sink,
                                 Function CMPIAssociationMIFT::*function, Words... words)
{
    const Module::Use use(_module);
    const Class_Entry& named = _classes.get(path.class_name, CIM_ERR_INVALID_PARAMETER);
    const std::vector<const Class_Entry*> asked = concerned_associations(_classes, _module.repository(), named, filter, ends);
    const std::optional<Object_Path> source = source_of(named, path);
    if (source)
        for (const Class_Entry* provider : asked)
            if (CMPIAssociationMI* mi = _module.association_mi(*provider))
                Provider_Call(_module, *provider, ends == Ends::both ? "Associators" : "References", *source, sink)
                    .run(mi, mi->ft->*function, provider->meta_class->name, words...);
    remove_duplicates(sink.found);
    return std::move(sink.found);
}

std::vector<Instance> Module_Operations::associators(const Object_Path& path, const Association_Filter& filter,
                                                     const Property_List& properties)
{
    Name_List names(properties);
    return traverse(path, filter, Ends::both, Instance_Sink(_name_space, properties), &CMPIAssociationMIFT::associators,
                    word(filter.result_class), word(filter.role), word(filter.result_role), names.names());
}

std::vector<Object_Path> Module_Operations::associator_names(const Object_Path& path, const Association_Filter& filter)
{
    return traverse(path, filter, Ends::both, Path_Sink(_name_space), &CMPIAssociationMIFT::associatorNames,
                    word(filter.result_class), word(filter.role), word(filter.result_role));
}

std::vector<Instance> Module_Operations::references(const Object_Path& path, const Association_Filter& filter,
                                                    const Property_List& properties)
{
    Name_List names(properties);
    return traverse(path, filter, Ends::source, Instance_Sink(_name_space, properties), &CMPIAssociationMIFT::references,
                    word(filter.role), names.names());
}

std::vector<Object_Path> Module_Operations::reference_names(const Object_Path& path, const Association_Filter& filter)
{
    return traverse(path, filter, Ends::source, Path_Sink(_name_space), &CMPIAssociationMIFT::referenceNames, word(filter.role));
}

} // namespace cimserver
