#include "inventory/wanted.h"

#include "inventory/address_text.h"
#include "inventory/property_text.h"
#include "runtime/ascii.h"

#include <algorithm>

namespace zmlr
{

namespace
{

void append_comparable(String& out, const char* text)
{
    for (; *text; text++)
    {
        if (*text != '-')
            out.append(static_cast<char>(ascii::to_lower(*text)));
    }
}

bool holds(const String& keys, const char* text, const char* end)
{
    String part;
    append_comparable(part, text);
    part.append(end);
    return keys.find(part) != String::npos;
}

// A property's text; null when it has none.
const String* text_of(const Instance* model, const Meta_Property* property)
{
    if (property->type != STRING || property->subscript != 0 || null_of(model, property))
        return nullptr;
    return static_cast<const String*>(address_of(model, property->offset));
}

bool may_be_ioc(const Wanted& wanted, const hxal_t* ioc)
{
    // An address of zeros is none, and stands in many keys.
    const mac_t mac = hxal_ioc_get_mac(ioc);
    if (std::ranges::any_of(mac.mac, [](auto byte) { return byte != 0; }) && wanted.may_hold(ProviderUtil::mac_text(mac).c_str()))
        return true;
    for (const wwn_t wwn : {hxal_ioc_get_pwwn(ioc), hxal_ioc_get_nwwn(ioc)})
    {
        if (wwn != 0 && wanted.may_hold(ProviderUtil::wwn_text(wwn).c_str()))
            return true;
    }
    const String interface_name = property_text(ioc->eth_name);
    if (!interface_name.empty() && wanted.may_end_with(interface_name.c_str()))
        return true;
    return wanted.may_hold(property_text(ioc->serialnum).c_str());
}

} // namespace

Wanted::Wanted(const Instance* model)
{
    String keys;
    for (uint32 i = 0; i < model->meta_class->num_meta_features; i++)
    {
        const Meta_Feature* feature = model->meta_class->meta_features[i];
        if (!is_property(feature) || !is_key(feature))
            continue;
        const String* key = text_of(model, as_property(feature));
        if (!key || key->empty())
            return;
        append_comparable(keys, key->c_str());
        keys.append('\n');
    }
    _keys = keys;
}

bool Wanted::may_hold(const char* text) const { return is_all() || (*text && holds(_keys, text, "")); }

bool Wanted::may_end_with(const char* text) const { return is_all() || holds(_keys, text, "\n"); }

bool Wanted::may_be_of(const Open_Port& port) const
{
    return is_all() || (port.fc && may_be_ioc(*this, port.fc.get())) || (port.ethernet && may_be_ioc(*this, port.ethernet.get()));
}

} // namespace zmlr
