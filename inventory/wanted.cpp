#include "inventory/wanted.h"

#include "inventory/property_text.h"
#include "runtime/ascii.h"
#include "text/integers.h"

#include <algorithm>
#include <cstring>
#include <optional>
#include <span>
#include <string_view>

namespace zmlr
{

namespace
{

constexpr uint32 longest_key = 512; // longer than any of ours: a client's may be of any size

// A property's text; null when it has none.
const String* text_of(const Instance* model, const Meta_Property* property)
{
    if (property->type != STRING || property->subscript != 0 || null_of(model, property))
        return nullptr;
    return static_cast<const String*>(address_of(model, property->offset));
}

int digit_of(char c)
{
    const char lower = static_cast<char>(ascii::to_lower(c));
    if (ascii::is_digit(c))
        return c - '0';
    return lower >= 'a' && lower <= 'f' ? lower - 'a' + 10 : -1;
}

// The digits in a key, hyphens left out; -1 for everything else.
std::vector<int> digits_in(const String& key)
{
    std::vector<int> digits;
    for (const char* c = key.c_str(); *c; c++)
    {
        if (*c != '-')
            digits.push_back(digit_of(*c));
    }
    return digits;
}

std::uint64_t as_number(const void* bytes, std::size_t size)
{
    std::uint64_t number = 0;
    std::memcpy(&number, bytes, size);
    return number;
}

// Appends every address of `size` bytes that stands in the digits.
void append_addresses(std::vector<std::uint64_t>& addresses, std::span<const int> digits, std::size_t size)
{
    for (std::size_t i = 0; i + 2 * size <= digits.size(); i++)
    {
        const auto part = digits.subspan(i, 2 * size);
        if (std::ranges::find(part, -1) != part.end())
            continue;
        unsigned char bytes[sizeof(std::uint64_t)] = {};
        for (std::size_t byte = 0; byte < size; byte++)
            bytes[byte] = static_cast<unsigned char>(part[2 * byte] << 4 | part[2 * byte + 1]);
        addresses.push_back(as_number(bytes, sizeof bytes));
    }
}

// What stands behind the last underscore, when it is a number.
std::optional<std::uint64_t> number_at_end(const String& key)
{
    const std::string_view text(key.c_str(), key.size());
    const std::size_t underscore = text.rfind('_');
    return underscore == text.npos ? std::nullopt : text::read_digits(text.substr(underscore + 1), 10);
}

// An address of zeros is none, and stands in many keys.
bool holds(const std::vector<std::uint64_t>& addresses, std::uint64_t address)
{
    return address != 0 && std::ranges::find(addresses, address) != addresses.end();
}

// Names and serial numbers that are counted up differ at their ends. A byte that may be shown as another is like any.
bool ends_alike(const String& key, const char* field, std::size_t size)
{
    for (std::size_t i = size; i > 0; i--)
    {
        if (ascii::to_lower(field[i - 1]) != ascii::to_lower(key.c_str()[i - 1]))
            return static_cast<signed char>(field[i - 1]) < ' ';
    }
    return true;
}

constexpr std::uint64_t size_bit(std::size_t size) { return size < 64 ? std::uint64_t{1} << size : 0; }

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
        const std::vector<int> digits = digits_in(*key);
        append_addresses(_wwns, digits, sizeof(wwn_t));
        append_addresses(_macs, digits, sizeof(mac_t));
        if (const std::optional<std::uint64_t> number = number_at_end(*key))
            _numbers.push_back(*number);
        _sizes |= size_bit(key->size());
        _keys.push_back(*key);
    }
}

bool Wanted::may_hold(wwn_t wwn) const { return is_all() || holds(_wwns, wwn); }

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

bool Wanted::may_end_with_number(std::uint32_t number) const
{
    return is_all() || std::ranges::find(_numbers, number) != _numbers.end();
}

template <std::size_t N> bool Wanted::has_key(const char (&field)[N]) const
{
    static_assert(N <= 64);
    const std::size_t size = ::strnlen(field, N);
    return (_sizes & size_bit(size)) != 0 && std::ranges::any_of(_keys,
                                                                 [&](const String& key) {
                                                                     return key.size() == size && ends_alike(key, field, size) &&
                                                                            key.equali(property_text(field));
                                                                 });
}

bool Wanted::may_be_of_ioc(const hxal_t& ioc) const
{
    return holds(_wwns, ioc.pwwn) || holds(_wwns, ioc.nwwn) || holds(_macs, as_number(ioc.mac.mac, sizeof ioc.mac.mac)) ||
           has_key(ioc.eth_name) || has_key(ioc.serialnum);
}

bool Wanted::may_be_of(const Open_Port& port) const
{
    return is_all() || (port.fc && may_be_of_ioc(*port.fc)) || (port.ethernet && may_be_of_ioc(*port.ethernet));
}

} // namespace zmlr
