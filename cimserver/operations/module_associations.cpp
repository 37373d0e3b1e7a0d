// Association traversal: every association provider that can concern the source is asked, with its own class name.
#include "cimserver/operations/module_operations.h"

#include "cimserver/model/paths.h"
#include "cimserver/operations/key_conversion.h"
#include "cimserver/operations/provider_call.h"

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

template <class Ask>
void Module_Operations::ask_associations(const Object_Path& path, const Association_Filter& filter, Ends ends, Result_Sink& sink,
                                         Ask ask)
{
    const Class_Entry* named = _classes.find(path.class_name);
    if (!named)
        throw Cim_Error(CIM_ERR_INVALID_PARAMETER, "there is no class " + path.class_name);
    const std::vector<const Class_Entry*> asked = concerned_associations(_classes, _module.repository(), *named, filter, ends);
    const std::optional<Object_Path> source = source_of(*named, path);
    if (!source)
        return;

    for (const Class_Entry* provider : asked)
        if (CMPIAssociationMI* mi = _module.association_mi(*provider))
        {
            Provider_Call call(_module, *provider, ends == Ends::both ? "Associators" : "References", *source, sink);
            ask(call, mi, provider->meta_class->name);
        }
}

std::vector<Instance> Module_Operations::associators(const Object_Path& path, const Association_Filter& filter,
                                                     const Property_List& properties)
{
    const Module::Use use(_module);
    Instance_Sink sink(_name_space, properties);
    Name_List names(properties);
    ask_associations(path, filter, Ends::both, sink,
                     [&](Provider_Call& call, CMPIAssociationMI* mi, const char* own_class)
                     {
                         call.run(mi, mi->ft->associators, own_class, word(filter.result_class), word(filter.role),
                                  word(filter.result_role), names.names());
                     });
    remove_duplicates(sink.found);
    return std::move(sink.found);
}

std::vector<Object_Path> Module_Operations::associator_names(const Object_Path& path, const Association_Filter& filter)
{
    const Module::Use use(_module);
    Path_Sink sink(_name_space);
    ask_associations(path, filter, Ends::both, sink,
                     [&](Provider_Call& call, CMPIAssociationMI* mi, const char* own_class) {
                         call.run(mi, mi->ft->associatorNames, own_class, word(filter.result_class), word(filter.role),
                                  word(filter.result_role));
                     });
    remove_duplicates(sink.found);
    return std::move(sink.found);
}

std::vector<Instance> Module_Operations::references(const Object_Path& path, const Association_Filter& filter,
                                                    const Property_List& properties)
{
    const Module::Use use(_module);
    Instance_Sink sink(_name_space, properties);
    Name_List names(properties);
    ask_associations(path, filter, Ends::source, sink,
                     [&](Provider_Call& call, CMPIAssociationMI* mi, const char* own_class)
                     { call.run(mi, mi->ft->references, own_class, word(filter.role), names.names()); });
    remove_duplicates(sink.found);
    return std::move(sink.found);
}

std::vector<Object_Path> Module_Operations::reference_names(const Object_Path& path, const Association_Filter& filter)
{
    const Module::Use use(_module);
    Path_Sink sink(_name_space);
    ask_associations(path, filter, Ends::source, sink,
                     [&](Provider_Call& call, CMPIAssociationMI* mi, const char* own_class)
                     { call.run(mi, mi->ft->referenceNames, own_class, word(filter.role)); });
    remove_duplicates(sink.found);
    return std::move(sink.found);
}

} // namespace cimserver
