// Reading what a scenario says of the transceiver of a port.
#include "sim/scenario/port_scenario.h"
#include "sim/scenario/scenario_words.h"

#include <cstring>

namespace hxasim
{

namespace
{

template <std::size_t size> void read_padded(Json_Object& object, std::string_view key, std::uint8_t (&field)[size])
{
    if (object.has(key))
        put_padded(field, object.text(key, size, ""));
}

void read_byte(Json_Object& object, std::string_view key, std::uint8_t& field)
{
    field = static_cast<std::uint8_t>(object.number(key, 255, field));
}

void read_memory(Json_Object& object, sfp_mem_t& memory)
{
    auto& base = memory.serial_id_base;
    base.identifier = static_cast<std::uint8_t>(object.choice("identifier", sfp_identifier_words, 255, base.identifier));
    read_byte(object, "ethernet_compliance", base.xcvr[0]);
    read_byte(object, "fc_speeds", base.xcvr[7]);
    read_padded(object, "vendor", base.vendor_name);
    read_padded(object, "part_number", base.vendor_pn);
    read_padded(object, "revision", base.vendor_rev);
    read_padded(object, "serial", memory.serial_id_ext.vendor_sn);
    read_padded(object, "date_code", memory.serial_id_ext.date_code);
    seal(memory);
    const auto bytes = object.bytes("memory", sizeof(memory));
    if (!bytes.empty())
        std::memcpy(&memory, bytes.data(), bytes.size());
}

} // namespace

void read_sfp(Json_Object& object, Port& port, const Adapter& adapter)
{
    auto& module = port.sfp;
    module = usual_sfp(adapter.max_speed, adapter.serial + "-" + std::to_string(adapter.ports.size()));
    auto keys = object.object("sfp");
    if (!keys)
        return;
    module.present = keys->boolean("present", true);
    module.media = static_cast<hxa_defs_sfp_media_t>(keys->choice("media", sfp_media_words, max_u32, module.media));
    read_memory(*keys, module.memory);
    keys->done();
}

} // namespace hxasim
