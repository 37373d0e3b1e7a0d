#include "cli/config_settings.h"

#include "cli/failure.h"
#include "cli/field_text.h"
#include "cli/trees.h"
#include "cli/words.h"
#include "hxal/value_names.h"

#include <algorithm>
#include <iterator>

namespace hxa
{

namespace
{

using Entry = hxal_ioc_config_t;

template <auto Member> Value number(const Entry& entry) { return std::uint64_t{entry.*Member}; }
template <auto Member> Value text(const Entry& entry) { return field_text(entry.*Member); }
template <auto Member> Value truth(const Entry& entry) { return entry.*Member ? "TRUE" : "FALSE"; }
template <auto Member> Value on_off(const Entry& entry) { return entry.*Member ? "on" : "off"; }
template <auto Member> Value bits(const Entry& entry)
{
    List numbers;
    for (unsigned bit = 0; bit < 32; ++bit)
        if (std::uint32_t{entry.*Member} >> bit & 1)
            numbers.push_back(bit);
    return numbers;
}

// The word of a number; the number itself when it has none.
template <std::size_t Size> Value word_of(const char* const (&words)[Size], unsigned value)
{
    return value < Size && *words[value] ? Value(words[value]) : Value(value);
}

// clang-format off
constexpr const char* topologies[] = {"none", "p2p", "loop", "auto"};
constexpr const char* log_levels[] = {"None", "Critical", "Error", "Warning", "Info"};
constexpr const char* algorithms[] = {"", "md5", "sha1", "ms", "sm"};
constexpr const char* sources[]    = {"", "LOCAL", "RADIUS", "TACACS"};

Value topology(const Entry& entry) { return word_of(topologies, entry.topology); }
Value log_level(const Entry& entry) { return word_of(log_levels, static_cast<unsigned>(entry.log)); }
Value algorithm(const Entry& entry) { return word_of(algorithms, entry.authalgo); }
Value source(const Entry& entry) { return word_of(sources, entry.authssource); }
Value address(const Entry& entry) { return "0x" + hexadecimal(entry.alpa, 2); }
Value secret(const Entry&) { return "(set)"; } // enciphered, and nobody's business all the same

constexpr const char* truths   = "TRUE or FALSE";
constexpr const char* switches = "on or off";

constexpr Setting rows[] = {
    {"port-name",          HXAL_CONFIG_PORT_NAME,          "a text",                             0,      text<&Entry::name>},
    {"eth-name",           HXAL_CONFIG_ETH_NAME,           "a text",                             0,      text<&Entry::ethname>},
    {"port-speed",         HXAL_CONFIG_PORT_SPEED,         "Gbit/s, 0 for any",                  10,     number<&Entry::speed>},
    {"port-topology",      HXAL_CONFIG_PORT_TOPOLOGY,      "none, p2p, loop or auto",            0,      topology},
    {"port-hardalpa",      HXAL_CONFIG_PORT_HARDALPA,      "a loop address, hexadecimal",        0,      address},
    {"port-maxfrsize",     HXAL_CONFIG_PORT_MAXFRSIZE,     "bytes",                              2112,   number<&Entry::maxfrsz>},
    {"port-trunk",         HXAL_CONFIG_PORT_TRUNK,         "numbers of ports, separated by \",\"", 0,    bits<&Entry::trunking>},
    {"port-enable",        HXAL_CONFIG_PORT_ENABLE,        truths,                               0,      truth<&Entry::enable>},
    {"ipfc-enable",        HXAL_CONFIG_IPFC_ENABLE,        truths,                               0,      truth<&Entry::ipfc_enable>},
    {"log-level",          HXAL_CONFIG_LOG_LEVEL,          "Critical, Error, Warning or Info",   0,      log_level},
    {"vf-enable",          HXAL_CONFIG_VF_ENABLE,          truths,                               0,      truth<&Entry::vf_enable>},
    {"vf-default",         HXAL_CONFIG_VF_DEFAULT,         "the number of a virtual fabric",     0xFFFF, number<&Entry::vf_default_id>},
    {"vf-list",            HXAL_CONFIG_VF_LIST,            "numbers, separated by \",\"",        0,      bits<&Entry::vf_list>},
    {"auth-policy",        HXAL_CONFIG_AUTH_POLICY,        switches,                             0,      on_off<&Entry::authpolicy>},
    {"auth-algo",          HXAL_CONFIG_AUTH_ALGO,          "md5, sha1, ms or sm",                0,      algorithm},
    {"auth-group",         HXAL_CONFIG_AUTH_GROUP,         "0, 1, 2, 4, 8 or 256",               256,    number<&Entry::authgroup>},
    {"auth-secretsource",  HXAL_CONFIG_AUTH_SECRETSOURCE,  "LOCAL, RADIUS or TACACS",            0,      source},
    {"auth-encrypt",       HXAL_CONFIG_AUTH_ENCRYPT,       "(not set here)",                     0,      secret},
    {"pathtov",            HXAL_CONFIG_PATHTOV,            "seconds",                            0xFFFF, number<&Entry::pathtov>},
    {"qdepth",             HXAL_CONFIG_QDEPTH,             "a number",                           0xFFFF, number<&Entry::qdepth>},
    {"qos",                HXAL_CONFIG_QOS,                truths,                               0,      truth<&Entry::qos>},
    {"ratelim",            HXAL_CONFIG_RATELIM,            truths,                               0,      truth<&Entry::ratelim>},
    {"ratelim-defspeed",   HXAL_CONFIG_RATELIM_DEFSPEED,   "Gbit/s",                             10,     number<&Entry::defspeed>},
    {"coalesce",           HXAL_CONFIG_COALESCE,           switches,                             0,      on_off<&Entry::coalesce>},
    {"delay",              HXAL_CONFIG_DELAY,              "microseconds",                       0xFFFF, number<&Entry::delay>},
    {"latency",            HXAL_CONFIG_LATENCY,            "microseconds",                       0xFFFF, number<&Entry::latency>},
    {"persistent-binding", HXAL_CONFIG_PERSISTENT_BINDING, truths,                               0,      truth<&Entry::binding>},
};
// clang-format on

} // namespace

std::span<const Setting> settings() { return rows; }

const Setting& setting_named(const std::string& name)
{
    const auto found = std::find_if(std::begin(rows), std::end(rows), [&](const Setting& row) { return name == row.name; });
    if (found != std::end(rows))
        return *found;
    std::string names;
    for (const auto& row : rows)
        names += std::string(names.empty() ? "" : ", ") + row.name;
    throw Failure(Exit::usage, '"' + safe_text(name) + "\" is no setting: " + names);
}

void check_value(const Setting& setting, const std::string& value)
{
    if (setting.code == HXAL_CONFIG_AUTH_ENCRYPT)
        throw Failure(Exit::usage, "auth-encrypt is enciphered: it is kept, and not set here");
    if (setting.most != 0)
        read_number(value, setting.most, 10, std::string("value of ") + setting.name + " (" + setting.values + ")");
    else if (setting.code == HXAL_CONFIG_PORT_HARDALPA)
        read_number(value, 0xEF, 16, std::string("value of ") + setting.name);
    else if (setting.code == HXAL_CONFIG_PORT_TRUNK || setting.code == HXAL_CONFIG_VF_LIST)
        read_bits(value, setting.code == HXAL_CONFIG_PORT_TRUNK ? 7 : 15, std::string("value of ") + setting.name);
}

} // namespace hxa
