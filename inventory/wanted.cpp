#include "inventory/wanted.h"

#include "runtime/ascii.h"
#include "schema/ZEMLAR_LANEndpoint.h"
#include "text/integers.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <optional>
#include <string_view>
#include <utility>

namespace zmlr
{

namespace
{

constexpr uint32 longest_key = 512; // longer than any of ours: a client's may be of any size

// What is compared of a name, and where its last 8 bytes begin.
constexpr std::size_t compared_size = sizeof(hxal_t::serialnum);
constexpr std::size_t last_bytes_at = compared_size - sizeof(std::uint64_t);
static_assert(compared_size <= sizeof(hxal_t::eth_name));

// A property's text; null when it has none.
const String* text_of(const Instance* model, const Meta_Property* property)
{
    if (property->type != STRING || property->subscript != 0 || null_of(model, property))
        return nullptr;
    return static_cast<const String*>(address_of(model, property->offset));
}

// Whether a key, by its name, tells nothing of the adapter or port that an instance is of.
bool tells_no_place(std::string_view name)
{
    return name.ends_with("CreationClassName") || name == "SystemName" || name == "Vendor" || name == "Version";
}

// What a key is, whatever it looks like.
bool is_serial_number(std::string_view name) { return name == "IdentifyingNumber"; }
bool is_interface(std::string_view name, const Meta_Class* meta_class)
{
    return name == "Name" && meta_class == &ZEMLAR_LANEndpoint::static_meta_class;
}

int digit_of(char c)
{
    const char lower = static_cast<char>(ascii::to_lower(c));
    if (ascii::is_digit(c))
        return c - '0';
    return lower >= 'a' && lower <= 'f' ? lower - 'a' + 10 : -1;
}

template <std::size_t size> std::uint64_t as_number(const void* bytes)
{
    std::uint64_t number = 0;
    std::memcpy(&number, bytes, size);
    return number;
}

wwn_t wwn_of(std::uint64_t number)
{
    std::array<unsigned char, sizeof(wwn_t)> bytes;
    for (std::size_t i = bytes.size(); i > 0; i--, number >>= 8)
        bytes[i - 1] = static_cast<unsigned char>(number);
    return std::bit_cast<wwn_t>(bytes);
}

// What stands behind the last underscore, when it is a number; the text is cut before it.
std::optional<std::uint64_t> cut_number(std::string_view& text)
{
    const std::size_t underscore = text.rfind('_');
    if (underscore == text.npos)
        return std::nullopt;
    const std::string_view digits = text.substr(underscore + 1);
    text = text.substr(0, underscore);
    return text::read_digits(digits, 10);
}

bool holds(const std::vector<std::uint64_t>& numbers, std::uint64_t number)
{
    return std::ranges::find(numbers, number) != numbers.end();
}

// The first of a list, linked through `next`, up to its end that fits, else the end.
template <class Node, class Fits> Node* first_that(Node* node, Node* end, Fits fits)
{
    while (node != end && !fits(*node))
        node = node->next;
    return node;
}

template <class Is_Of> bool has_ioc(const hxal_adapter_t& adapter, Iocs iocs, Is_Of is_of)
{
    return (iocs != Iocs::ethernet && first_that<hxal_t>(adapter.fcioc_list, nullptr, is_of)) ||
           (iocs != Iocs::fc && first_that<hxal_t>(adapter.ethioc_list, nullptr, is_of));
}

template <class Is_Of> bool has_port_0(const hxal_t* list, Is_Of is_of)
{
    const hxal_t* port_0 = first_that<const hxal_t>(list, nullptr, [](const hxal_t& ioc) { return ioc.id == 0; });
    return port_0 && is_of(*port_0);
}

} // namespace

Wanted::Wanted(const Instance* model)
{
    for (uint32 i = 0; i < model->meta_class->num_meta_features; i++)
    {
        const Meta_Feature* feature = model->meta_class->meta_features[i];
        if (!is_property(feature) || !is_key(feature))
            continue;
        const String* key = text_of(model, as_property(feature));
        if (!key || key->empty() || key->size() > longest_key)
        {
            *this = Wanted();
            return;
        }
        if (tells_no_place(feature->name))
            continue;
        _keys.push_back(*key);
        if (is_serial_number(feature->name))
            _serial_numbers.emplace_back(*key);
        else if (is_interface(feature->name, model->meta_class))
            _interfaces.emplace_back(*key);
        else if (!append_numbers(*key))
        {
            *this = Wanted();
            return;
        }
    }
}

bool Wanted::append_numbers(const String& key)
{
    std::string_view text(key.c_str(), key.size());
    const std::optional<std::uint64_t> number = cut_number(text);
    if (number)
        _numbers.push_back(*number);
    if (const std::optional<std::uint64_t> before = cut_number(text); number && before)
        _places.push_back({*before, *number});

    // Hyphens between digits do not count.
    bool all_tell = true;
    std::size_t digits = 0;
    std::uint64_t last = 0; // 16 of them
    for (const char* c = key.c_str(); *c; c++)
    {
        const int digit = digit_of(*c);
        if (digit >= 0)
        {
            digits++;
            last = last << 4 | static_cast<std::uint64_t>(digit);
        }
        else if (*c != '-')
            all_tell = append_address(std::exchange(digits, 0), last) && all_tell;
    }
    return append_address(digits, last) && all_tell;
}

// A row of digits may end with a WWN or with a MAC address: what has zeros before the 12 digits of a MAC may be either.
bool Wanted::append_address(std::size_t digits, std::uint64_t number)
{
    constexpr std::uint64_t mac_digits = 0xFFFF'FFFF'FFFF;
    if (digits >= 2 * sizeof(wwn_t) && number > mac_digits)
        _wwns.push_back(wwn_of(number));
    else if (digits >= 2 * sizeof(mac_t))
    {
        _macs.push_back(wwn_of(number & mac_digits));
        return (number & mac_digits) != 0;
    }
    return true;
}

Wanted::Name::Name(const String& key)
{
    unsigned char mask[compared_size];
    unsigned char value[compared_size];
    for (std::size_t i = 0; i < compared_size; i++)
    {
        const char c = i < key.size() ? key.c_str()[i] : '\0';
        const bool is_letter = ascii::to_lower(c) >= 'a' && ascii::to_lower(c) <= 'z';
        mask[i] = c == '?' ? 0 : is_letter ? 0xDF : 0xFF;
        value[i] = static_cast<unsigned char>(c) & mask[i];
    }
    first_mask = as_number<sizeof first_mask>(mask);
    first = as_number<sizeof first>(value);
    last_mask = as_number<sizeof last_mask>(mask + last_bytes_at);
    last = as_number<sizeof last>(value + last_bytes_at);
}

// Names that are counted up differ at their ends.
bool Wanted::Name::is_in(const char* field) const
{
    return (as_number<sizeof last>(field + last_bytes_at) & last_mask) == last &&
           (as_number<sizeof first>(field) & first_mask) == first;
}

bool Wanted::may_hold(wwn_t wwn) const { return is_all() || holds(_wwns, wwn) || holds(_macs, wwn); }

bool Wanted::may_end_with(const char* text) const
{
    const std::size_t size = std::strlen(text);
    return is_all() || std::ranges::any_of(_keys,
                                           [&](const String& key)
                                           {
                                               const std::size_t begin = key.size() - std::min<std::size_t>(size, key.size());
                                               return eqi(key.c_str() + begin, text);
                                           });
}

bool Wanted::may_end_with_number(std::uint32_t number) const { return is_all() || holds(_numbers, number); }

// Numbers are copied to stay in registers while a list is passed over. Addresses that are counted up differ at their ends.
template <class Use> void Wanted::use_tests(Use use) const
{
    for (const wwn_t wwn : _wwns)
        use([=](const hxal_t& ioc) { return ioc.pwwn == wwn || ioc.nwwn == wwn; });
    for (const wwn_t wwn : _macs)
    {
        const auto bytes = std::bit_cast<std::array<char, sizeof wwn>>(wwn);
        const std::uint64_t first = as_number<2>(bytes.data() + 2);
        const std::uint64_t last = as_number<4>(bytes.data() + 4);
        use(
            [=](const hxal_t& ioc)
            {
                const bool is_mac = as_number<4>(ioc.mac.mac + 2) == last && as_number<2>(ioc.mac.mac) == first;
                return is_mac || ioc.pwwn == wwn || ioc.nwwn == wwn;
            });
    }
    for (const Name& name : _serial_numbers)
        use([=](const hxal_t& ioc) { return name.is_in(ioc.serialnum); });
    for (const Name& name : _interfaces)
        use([=](const hxal_t& ioc) { return name.is_in(ioc.eth_name); });
}

bool Wanted::may_be_of(int adapter, int port, const hxal_t* ethernet, const hxal_t* fc) const
{
    const Place place = {static_cast<std::uint64_t>(adapter), static_cast<std::uint64_t>(port)};
    bool may_be = is_all() || std::ranges::find(_places, place) != _places.end();
    use_tests([&](auto is_of) { may_be = may_be || (ethernet && is_of(*ethernet)) || (fc && is_of(*fc)); });
    return may_be;
}

hxal_adapter_t* Wanted::first_of(hxal_adapter_t* list, Ports ports, Iocs iocs) const
{
    hxal_adapter_t* first = is_all() ? list : nullptr;
    for (const Place& place : _places)
        first = first_that(
            list, first, [=](const hxal_adapter_t& adapter) { return static_cast<std::uint64_t>(adapter.id) == place.adapter; });
    use_tests(
        [&](auto is_of)
        {
            if (ports == Ports::first)
                first = first_that(list, first,
                                   [=](const hxal_adapter_t& adapter)
                                   { return has_port_0(adapter.fcioc_list, is_of) || has_port_0(adapter.ethioc_list, is_of); });
            else
                first = first_that(list, first, [=](const hxal_adapter_t& adapter) { return has_ioc(adapter, iocs, is_of); });
        });
    return first;
}

} // namespace zmlr
