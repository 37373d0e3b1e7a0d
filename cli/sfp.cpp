#include "cli/sfp.h"

#include "cli/field_text.h"
#include "cli/report.h"
#include "hxal/diag.h"
#include "hxal/sfp.h"
#include "hxal/value_names.h"

namespace hxa
{

namespace
{

constexpr std::uint8_t self_calibrated = 0x20; // bit of diag_mon_type

// clang-format off
constexpr Column columns[] = {
    {"Port",           "port"},
    {"Medium",         "medium"},
    {"Identifier",     "identifier"},
    {"Vendor",         "vendor"},
    {"Vendor OUI",     "vendor_oui"},
    {"Part number",    "part_number"},
    {"Revision",       "revision"},
    {"Serial number",  "serial_number"},
    {"Date code",      "date_code"},
    {"Nominal rate",   "nominal_rate_megabaud", " MBd"},
    {"Wave length",    "wavelength_nanometers", " nm"},
    {"Reach SMF",      "reach_single_mode_meters", " m"},
    {"Reach OM3",      "reach_om3_meters", " m"},
    {"Reach OM2",      "reach_om2_meters", " m"},
    {"Reach OM1",      "reach_om1_meters", " m"},
    {"Reach copper",   "reach_copper_meters", " m"},
    {"Temperature",    "temperature_celsius", " C"},
    {"Voltage",        "voltage_millivolts", " mV"},
    {"Bias current",   "bias_milliamperes", " mA"},
    {"Transmit power", "transmit_power_microwatts", " uW"},
    {"Receive power",  "receive_power_microwatts", " uW"},
    {"Alarms",         "alarms"},
    {"Warnings",       "warnings"},
};

// In the order of the flags, from bit 15 down; after each high one its low one.
constexpr const char* monitored[] = {"temperature", "voltage", "bias", "transmit-power", "receive-power"};
// clang-format on

unsigned word_at(const std::uint8_t (&bytes)[2]) { return bytes[0] * 256u + bytes[1]; }

// A reach that the module does not tell is 0.
Value reach(unsigned meters) { return meters == 0 ? Value() : Value(meters); }

Value flags(const std::uint8_t (&bytes)[2])
{
    List names;
    const unsigned bits = word_at(bytes);
    unsigned bit = 15;
    for (const char* name : monitored)
        for (const char* end : {"-high", "-low"})
            if (bits >> bit-- & 1)
                names.push_back(std::string(name) + end);
    return names;
}

void add_identity(Object& tree, const sfp_mem_t& memory)
{
    const auto& base = memory.serial_id_base;
    const auto& more = memory.serial_id_ext;
    const unsigned single_mode = base.len_km ? base.len_km * 1000u : base.len_100m * 100u;
    for (auto& member :
         Object{{"identifier", unsigned{base.identifier}},
                {"vendor", field_text(base.vendor_name)},
                {"vendor_oui", hexadecimal(base.vendor_oui[0] * 0x10000u + base.vendor_oui[1] * 0x100u + base.vendor_oui[2], 6)},
                {"part_number", field_text(base.vendor_pn)},
                {"revision", field_text(base.vendor_rev)},
                {"serial_number", field_text(more.vendor_sn)},
                {"date_code", field_text(more.date_code)},
                {"nominal_rate_megabaud", base.br_norm * 100u},
                {"wavelength_nanometers", word_at(base.wavelen)},
                {"reach_single_mode_meters", reach(single_mode)},
                {"reach_om3_meters", reach(base.len_om3 * 10u)},
                {"reach_om2_meters", reach(base.len_om2 * 10u)},
                {"reach_om1_meters", reach(base.len_om1 * 10u)},
                {"reach_copper_meters", reach(base.len_cu)}})
        tree.push_back(member);
}

void add_monitored(Object& tree, const sfp_mem_t& memory)
{
    const auto& now = memory.diag_ext;
    for (auto& member : Object{{"temperature_celsius", static_cast<std::int16_t>(word_at(now.temperature)) / 256.0},
                               {"voltage_millivolts", word_at(now.voltage) / 10.0},
                               {"bias_milliamperes", word_at(now.bias) / 500.0},
                               {"transmit_power_microwatts", word_at(now.tx_power) / 10.0},
                               {"receive_power_microwatts", word_at(now.rx_power) / 10.0},
                               {"alarms", flags(now.alarm_flags)},
                               {"warnings", flags(now.warning_flags)}})
        tree.push_back(member);
}

} // namespace

Value sfp_tree(Session& session, const Port& port)
{
    Object tree{{"port", port.name()}};
    sfp_mem_t memory{};
    if (!session.accept(hxal_diag_sfp_query(port.ioc(), &memory), "module of port " + port.name()))
        return tree;
    hxa_defs_sfp_media_t media{};
    if (session.accept(hxal_sfp_media(port.ioc(), &media), "medium of port " + port.name()))
        tree.push_back({"medium", hxal_get_sfp_media(media)});
    add_identity(tree, memory);
    if (memory.serial_id_ext.diag_mon_type & self_calibrated)
        add_monitored(tree, memory);
    return tree;
}

std::string sfp_text(const Value& tree) { return details(tree, columns); }

} // namespace hxa
