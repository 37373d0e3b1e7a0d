#include "hxal/config/internal/settings.h"

#include "hxal/config/internal/syntax.h"
#include "hxal/config/syntax.h"

#include <cstring>
#include <limits>
#include <type_traits>

namespace hxal::config
{

namespace
{

// The words of a setting, by their number.
struct Words
{
    const char* word[5];
    unsigned first = 0; // smaller numbers are written, never read
    const char* end = ";";
};

// clang-format off
constexpr Words true_false    = {{"FALSE", "TRUE"}};
constexpr Words vf_true_false = {.word = {"FALSE", "TRUE"}, .end = ""};
constexpr Words on_off        = {{"off", "on"}};
constexpr Words topologies    = {{"none", "p2p", "loop", "auto"}};
constexpr Words log_levels    = {.word = {"None", "Critical", "Error", "Warning", "Info"}, .first = 1};
constexpr Words algorithms    = {.word = {nullptr, "md5", "sha1", "ms", "sm"}, .first = 1};
constexpr Words sources       = {.word = {nullptr, "LOCAL", "RADIUS", "TACACS"}, .first = 1};
// clang-format on

template <auto Member> using Field = std::remove_reference_t<decltype(std::declval<Ioc_Entry&>().*Member)>;

template <auto Member> bool store_characters(Ioc_Entry& entry, std::string_view text)
{
    copy(entry.*Member, text);
    return true;
}

template <auto Member> void write_characters(std::FILE* file, const char* key, const Ioc_Entry& entry)
{
    std::fprintf(file, "%s = \"", key);
    write_text(file, entry.*Member, sizeof(entry.*Member));
    std::fputs("\";\n", file);
}

template <auto Member> bool store_unsigned(Ioc_Entry& entry, uint32_t value)
{
    entry.*Member = value <= std::numeric_limits<Field<Member>>::max() ? static_cast<Field<Member>>(value) : 0;
    return true;
}

template <auto Member> bool store_decimal(Ioc_Entry& entry, std::string_view text)
{
    return store_unsigned<Member>(entry, static_cast<uint32_t>(number(text)));
}

template <auto Member> void write_decimal(std::FILE* file, const char* key, const Ioc_Entry& entry)
{
    std::fprintf(file, "%s = %u;\n", key, unsigned{entry.*Member});
}

template <auto Member> bool store_hexadecimal(Ioc_Entry& entry, std::string_view text)
{
    return store_unsigned<Member>(entry, hexadecimal(text));
}

template <auto Member> void write_hexadecimal(std::FILE* file, const char* key, const Ioc_Entry& entry)
{
    std::fprintf(file, "%s = 0x%x;\n", key, unsigned{entry.*Member});
}

template <auto Member> bool store_list(Ioc_Entry& entry, std::string_view text)
{
    entry.*Member = static_cast<Field<Member>>(bitmap(text));
    return true;
}

template <auto Member> void write_list(std::FILE* file, const char* key, const Ioc_Entry& entry)
{
    int positions[32];
    const int count = bmptolist(entry.*Member, positions, 32);
    std::fprintf(file, "%s = ", key);
    for (int i = 0; i < count; ++i)
        std::fprintf(file, i + 1 < count ? "%d, " : "%d;", positions[i]);
    std::fputc('\n', file);
}

template <auto Member, const Words& Table> bool store_word(Ioc_Entry& entry, std::string_view text)
{
    for (unsigned value = Table.first; value < std::size(Table.word); ++value)
        if (Table.word[value] && text == Table.word[value])
        {
            entry.*Member = static_cast<Field<Member>>(value);
            return true;
        }
    return false;
}

template <auto Member, const Words& Table> void write_word(std::FILE* file, const char* key, const Ioc_Entry& entry)
{
    const auto value = static_cast<unsigned>(entry.*Member);
    if (value < std::size(Table.word) && Table.word[value])
        std::fprintf(file, "%s = \"%s\"%s\n", key, Table.word[value], Table.end);
}

template <auto Member> constexpr Form text = {store_characters<Member>, write_characters<Member>};
template <auto Member> constexpr Form decimal = {store_decimal<Member>, write_decimal<Member>};
template <auto Member> constexpr Form hex = {store_hexadecimal<Member>, write_hexadecimal<Member>};
template <auto Member> constexpr Form list = {store_list<Member>, write_list<Member>};
template <auto Member, const Words& Table> constexpr Form word = {store_word<Member, Table>, write_word<Member, Table>};

using Ioc = Ioc_Entry;

// clang-format off
constexpr Setting settings[] = {
    {HXAL_CONFIG_PORT_WWN,           "hxa", "port-wwn",           For_All::read,    text<&Ioc::pwwn>},
    {HXAL_CONFIG_PORT_MAC,           "hxn", "port-mac",           For_All::unknown, text<&Ioc::mac>},
    {HXAL_CONFIG_PORT_NAME,          "hxa", "port-name",          For_All::read,    text<&Ioc::name>},
    {HXAL_CONFIG_ETH_NAME,           "hxn", "port-name",          For_All::unknown, text<&Ioc::ethname>},
    {HXAL_CONFIG_PORT_SPEED,         "hxa", "port-speed",         For_All::written, decimal<&Ioc::speed>},
    {HXAL_CONFIG_PORT_TOPOLOGY,      "hxa", "port-topology",      For_All::written, word<&Ioc::topology, topologies>},
    {HXAL_CONFIG_PORT_HARDALPA,      "hxa", "port-hardalpa",      For_All::read,    hex<&Ioc::alpa>},
    {HXAL_CONFIG_PORT_MAXFRSIZE,     "hxa", "port-maxfrsize",     For_All::written, decimal<&Ioc::maxfrsz>},
    {HXAL_CONFIG_PORT_TRUNK,         "hxa", "port-trunk",         For_All::written, list<&Ioc::trunking>},
    {HXAL_CONFIG_PORT_ENABLE,        "hxa", "port-enable",        For_All::written, word<&Ioc::enable, true_false>},
    {HXAL_CONFIG_IPFC_ENABLE,        "hxa", "ipfc-enable",        For_All::written, word<&Ioc::ipfc_enable, true_false>},
    {HXAL_CONFIG_LOG_LEVEL,          "hxa", "log-level",          For_All::written, word<&Ioc::log, log_levels>},
    {HXAL_CONFIG_VF_ENABLE,          "hxa", "vf-enable",          For_All::written, word<&Ioc::vf_enable, vf_true_false>},
    {HXAL_CONFIG_VF_DEFAULT,         "hxa", "vf-default",         For_All::written, decimal<&Ioc::vf_default_id>},
    {HXAL_CONFIG_VF_LIST,            "hxa", "vf-list",            For_All::written, list<&Ioc::vf_list>},
    {HXAL_CONFIG_AUTH_POLICY,        "hxa", "auth-policy",        For_All::written, word<&Ioc::authpolicy, on_off>},
    {HXAL_CONFIG_AUTH_ALGO,          "hxa", "auth-algo",          For_All::written, word<&Ioc::authalgo, algorithms>},
    {HXAL_CONFIG_AUTH_GROUP,         "hxa", "auth-group",         For_All::written, decimal<&Ioc::authgroup>},
    {HXAL_CONFIG_AUTH_SECRETSOURCE,  "hxa", "auth-secretsource",  For_All::written, word<&Ioc::authssource, sources>},
    {HXAL_CONFIG_AUTH_ENCRYPT,       "hxa", "auth-encrypt",       For_All::written, text<&Ioc::authsstring>},
    {HXAL_CONFIG_PATHTOV,            "hxa", "pathtov",            For_All::written, decimal<&Ioc::pathtov>},
    {HXAL_CONFIG_QDEPTH,             "hxa", "qdepth",             For_All::written, decimal<&Ioc::qdepth>},
    {HXAL_CONFIG_QOS,                "hxa", "qos",                For_All::written, word<&Ioc::qos, true_false>},
    {HXAL_CONFIG_RATELIM,            "hxa", "ratelim",            For_All::written, word<&Ioc::ratelim, true_false>},
    {HXAL_CONFIG_RATELIM_DEFSPEED,   "hxa", "ratelim-defspeed",   For_All::written, decimal<&Ioc::defspeed>},
    {HXAL_CONFIG_COALESCE,           "hxa", "coalesce",           For_All::written, word<&Ioc::coalesce, on_off>},
    {HXAL_CONFIG_DELAY,              "hxa", "delay",              For_All::written, decimal<&Ioc::delay>},
    {HXAL_CONFIG_LATENCY,            "hxa", "latency",            For_All::written, decimal<&Ioc::latency>},
    {HXAL_CONFIG_PERSISTENT_BINDING, "hxa", "persistent-binding", For_All::written, word<&Ioc::binding, true_false>},
};
// clang-format on

template <typename Fits> const Setting* first_setting(Fits fits)
{
    const auto found = std::find_if(std::begin(settings), std::end(settings), fits);
    return found == std::end(settings) ? nullptr : found;
}

// A tab is a blank to the parser: it can stand in a text that a person wrote.
bool is_control(char character) { return (character >= 0 && character < ' ' && character != '\t') || character == '\x7F'; }

bool store_adapter(hxal_ad_config_t& entry, int code, std::string_view value)
{
    switch (code)
    {
    case HXAL_CONFIG_AD_SERIAL: // may fill the field: a cut one would name no adapter in the file
        std::fill(std::copy_n(value.begin(), std::min(value.size(), sizeof entry.id), entry.id), std::end(entry.id), '\0');
        break;
    case HXAL_CONFIG_AD_NAME:
        copy(entry.name, value);
        break;
    default:
        entry.power = static_cast<uint32_t>(number(value));
    }
    set(entry.flags, code, true);
    return true;
}

} // namespace

const Setting* setting_of(int code)
{
    return first_setting([=](const Setting& setting) { return setting.code == code; });
}

const Setting* setting_with(std::string_view prefix, std::string_view key)
{
    return first_setting([=](const Setting& setting) { return setting.prefix == prefix && setting.key == key; });
}

const Setting* setting_for_all(std::string_view key)
{
    return first_setting([=](const Setting& setting) { return setting.for_all != For_All::unknown && setting.key == key; });
}

bool store(hxal_config_t& model, const Setting& setting, int idx, std::string_view value)
{
    if (!is_entry(idx))
        return false;
    Ioc_Entry& entry = model.iocs[idx];
    const bool understood = setting.form.store(entry, value);
    set(entry.flags, setting.code, understood);
    if (setting.code == HXAL_CONFIG_PORT_WWN)
        pwwn_changed(model, idx);
    return understood;
}

bool store(hxal_config_t& model, int code, int idx, std::string_view value)
{
    if (code >= HXAL_CONFIG_AD_SERIAL && code <= HXAL_CONFIG_AD_POWER)
        return is_entry(idx) && store_adapter(model.adapters[idx], code, value);
    const Setting* setting = setting_of(code);
    return setting && store(model, *setting, idx, value);
}

void store_for_all(hxal_config_t& model, int code, std::string_view text)
{
    const int count = code == HXAL_CONFIG_AD_POWER ? ad_get_num(model) : ioc_get_num(model);
    set(model.config_all, code, true);
    copy(model.for_all[code].text, text);
    model.for_all[code].reached = count;
    for (int idx = 0; idx < count; ++idx)
        store(model, code, idx, text);
}

void spread_for_all(hxal_config_t& model, int code)
{
    if (!is_for_all(model, code))
        return;
    hxal_config_for_all_t& given = model.for_all[code];
    const bool is_power = code == HXAL_CONFIG_AD_POWER;
    Ioc_Entry scratch{};
    if (!is_power && !setting_of(code)->form.store(scratch, given.text))
        return set(model.config_all, code, false);
    for (int idx = given.reached; idx < HXAL_CONFIG_ENTRIES; ++idx)
    {
        const Presence& flags = is_power ? model.adapters[idx].flags : model.iocs[idx].flags;
        if (has(flags, is_power ? HXAL_CONFIG_AD_SERIAL : HXAL_CONFIG_PORT_WWN) && !has(flags, code))
            store(model, code, idx, given.text);
    }
    given.reached = HXAL_CONFIG_ENTRIES;
}

void write_text(std::FILE* file, const char* text, std::size_t size)
{
    for (const char character : std::string_view(text, ::strnlen(text, size)))
        std::fputc(is_control(character) ? '?' : character, file);
}

} // namespace hxal::config
