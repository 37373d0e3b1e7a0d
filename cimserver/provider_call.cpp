#include "cimserver/provider_call.h"

#include "cimserver/broker/return_code.h"

namespace cimserver
{
namespace
{

// Empty when a provider gives no message, or none that the broker made.
std::string message(const CMPIString* string)
try
{
    return string ? object<String_Object>(string).text : "";
}
catch (const Failure&)
{
    return "";
}

} // namespace

Name_List::Name_List(const Property_List& properties, const Property_Layout* layout) : _absent(!properties)
{
    if (properties)
        for (const std::string& name : *properties)
            if (!layout || layout->find(name))
                _names.push_back(name.c_str());
    _names.push_back(nullptr);
}

const std::vector<bool>* Selection::flags(const std::shared_ptr<const Property_Layout>& layout)
{
    if (!_properties && !_named_class)
        return nullptr;
    if (layout != _layout)
    {
        _layout = layout;
        _flags = _properties ? layout->select(*_properties) : std::vector<bool>(layout->size(), true);
        hide_others();
    }
    return &_flags;
}

void Selection::hide_others()
{
    for (std::size_t slot = 0; _named_class && slot < _flags.size(); ++slot)
        if (!_named_class->find(_layout->slots()[slot].name))
            _flags[slot] = false;
}

void Path_Sink::take_path(const Object_Path& path)
{
    found.push_back(path);
    if (path.name_space.empty())
        found.back().name_space = _name_space;
}

void Instance_Sink::take_instance(const Instance_Object& instance)
{
    found.push_back(instance.model(_selection.flags(instance.shared_layout())));
    Object_Path& path = found.back().path;
    if (path.name_space.empty())
        path.name_space = _name_space;
    if (!path.keys.empty())
        return;
    const auto& slots = instance.layout().slots();
    for (std::size_t slot = 0; slot < slots.size(); ++slot)
        if (slots[slot].key)
            path.keys.push_back({slots[slot].name, instance.value(slot)});
}

void check_status(const Class_Entry& provider, const CMPIStatus& status)
{
    if (status.rc == CMPI_RC_OK)
        return;
    std::string description = std::string(provider.registration->provider_name) + ": " + return_code_name(status.rc);
    if (const auto text = message(status.msg); !text.empty())
        description += ": " + text;
    throw Cim_Error(cim_status(status.rc), description);
}

Provider_Call::Provider_Call(const Class_Entry& provider, Object_Path path, Result_Sink& sink, CMPIFlags flags)
    : _provider(provider)
    , _request(flags)
    , _result(make<Result_Object>(sink).face())
    , _path(make<Path_Object>(std::move(path)).face())
{
}

void Provider_Call::check_offered(bool offered) const
{
    if (!offered)
        throw Cim_Error(CIM_ERR_NOT_SUPPORTED, std::string(_provider.registration->provider_name) + " does not offer this");
}

} // namespace cimserver
