#include "cimserver/operations/provider_call.h"

#include "cimserver/broker/return_code.h"

namespace cimserver
{
Name_List::Name_List(const Property_List& properties, const Property_Layout* layout) : _absent(!properties)
{
    if (!properties)
        return;
    for (const std::string& name : *properties)
        if (!layout || layout->find(name))
            _names.push_back(name.c_str());
    _names.push_back(nullptr);
}

void Path_Sink::take_path(const Object_Path& path)
{
    found.push_back(path);
    if (path.name_space.empty())
        found.back().name_space = _name_space;
}

void Instance_Sink::take_instance(const Instance_Object& instance)
{
    if (_shown && _layout != instance.shared_layout())
    {
        _layout = instance.shared_layout();
        _flags = _layout->select(*_shown);
    }
    found.push_back(instance.model(_shown ? &_flags : nullptr));
    Object_Path& path = found.back().path;
    if (path.name_space.empty())
        path.name_space = _name_space;
    if (!path.keys.empty())
        return;
    const Property_Layout& layout = instance.layout();
    for (std::size_t place = 0; place < layout.size(); ++place)
        if (layout.is_key(place))
            path.keys.push_back({layout[place].name, instance.value(place)});
}

void check_status(const Class_Entry& provider, const char* action, const CMPIStatus& status)
{
    if (status.rc != CMPI_RC_OK)
        throw Cim_Error(cim_status(status.rc), outcome_text(provider.meta_class->name, action, status.rc));
}

void check_offered(const Class_Entry& provider, const char* action, bool offered)
{
    if (!offered)
        check_status(provider, action, {CMPI_RC_ERR_NOT_SUPPORTED, nullptr});
}

Provider_Call::Provider_Call(Module& module, const Class_Entry& provider, const char* action, Object_Path path, Result_Sink& sink,
                             CMPIFlags flags)
    : _module(module)
    , _provider(provider)
    , _action(action)
    , _request(flags)
    , _result(make<Result_Object>(sink).face())
    , _path(make<Path_Object>(std::move(path)).face())
{
}

} // namespace cimserver
