#include "cli/field_text.h"

#include "text/integers.h"
#include "text/safe_text.h"

#include <array>
#include <cstring>

namespace hxa
{

namespace
{

std::string digits_of(const void* bytes, std::size_t size)
{
    std::string text;
    for (std::size_t i = 0; i < size; ++i)
        text += hexadecimal(static_cast<const std::uint8_t*>(bytes)[i], 2);
    return text;
}

template <typename Address> std::optional<Address> read_address(std::string_view text)
{
    constexpr std::size_t size = sizeof(Address);
    const std::size_t step = text.size() == size * 3 - 1 ? 3 : 2;
    if (step == 2 && text.size() != size * 2)
        return std::nullopt;
    std::array<std::uint8_t, size> bytes;
    for (std::size_t i = 0; i < size; ++i)
    {
        const auto byte = text::read_digits(text.substr(i * step, 2), 16);
        if (!byte || (step == 3 && i > 0 && text[i * step - 1] != ':'))
            return std::nullopt;
        bytes[i] = static_cast<std::uint8_t>(*byte);
    }
    Address address;
    std::memcpy(&address, bytes.data(), size);
    return address;
}

} // namespace

std::string safe_text(std::string_view bytes)
{
    std::string safe = text::safe_text(bytes);
    safe.erase(safe.find_last_not_of(' ') + 1);
    return safe.erase(0, safe.find_first_not_of(' '));
}

std::string hexadecimal(std::uint64_t number, int digits)
{
    std::string text(static_cast<std::size_t>(digits), '0');
    for (auto digit = text.rbegin(); digit != text.rend(); ++digit, number >>= 4)
        *digit = "0123456789ABCDEF"[number & 0xF];
    return text;
}

std::string wwn_text(wwn_t wwn) { return digits_of(&wwn, sizeof wwn); }
std::string mac_text(const mac_t& mac) { return digits_of(mac.mac, sizeof mac.mac); }
std::string address_text(std::uint32_t pid) { return digits_of(&pid, 3); }

std::optional<wwn_t> read_wwn(std::string_view text) { return read_address<wwn_t>(text); }
std::optional<mac_t> read_mac(std::string_view text) { return read_address<mac_t>(text); }

} // namespace hxa
