#include "inventory/fru_number.h"

#include "runtime/log.h"
#include "runtime/trace.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <cstring>
#include <numeric>
#include <optional>
#include <span>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

// Positions in the data.
constexpr std::size_t plain_fru_at = 112;      // the text, of a card of the plain layout
constexpr std::size_t section_tag_at = 131;    // read-only section, behind an identifier string of fixed length
constexpr std::size_t section_length_at = 132; // 16 bits, little-endian
constexpr std::size_t header_at = 134;         // the vendor's header keyword
constexpr std::size_t keywords_at = 153;

constexpr std::uint8_t plain_layout = 1;
constexpr std::uint8_t identifier_string_tag = 0x82;
constexpr std::uint8_t read_only_section_tag = 0x90;
constexpr std::size_t keyword_head = 3; // two letters, a length
constexpr std::size_t fru_in_value = 19;
constexpr std::size_t fru_size = 16;

using Data = std::span<const std::uint8_t>;

String text_of(Data bytes)
{
    const char* text = reinterpret_cast<const char*>(bytes.data());
    return String(text, ::strnlen(text, bytes.size()));
}

// What of the data from `position` on is there, at most `size` bytes.
Data part_of(Data data, std::size_t position, std::size_t size)
{
    const std::size_t begin = std::min(position, data.size());
    return data.subspan(begin, std::min(size, data.size() - begin));
}

std::optional<std::size_t> checksum_position(Data data)
{
    for (std::size_t i = 0; i + 1 < data.size(); i++)
    {
        if (data[i] == 'R' && data[i + 1] == 'V')
            return i;
    }
    return std::nullopt;
}

bool sums_to_zero(Data bytes) { return std::accumulate(bytes.begin(), bytes.end(), 0U) % 256 == 0; }

// Why the data up to the limit cannot be read; null when they can.
const char* fault_of(Data data, std::size_t limit)
{
    const std::optional<std::size_t> checksum = checksum_position(part_of(data, 0, limit + 1));
    if (!checksum)
        return "Corrupted pci data, return empty FRU.";
    if (!sums_to_zero(part_of(data, 0, *checksum + keyword_head + 1)))
        return "check sum error, return empty FRU.";
    if (data[0] != identifier_string_tag || data[section_tag_at] != read_only_section_tag)
        return "incorrect LR_STR_TAG, return empty FRU.";
    if (data[header_at] != 'V' || data[header_at + 1] != '0')
        return "zemlar header not found, return empty FRU.";
    return nullptr;
}

// The number in the value of a keyword; none when the value carries something else.
std::optional<String> fru_of(Data value)
{
    std::array<char, 256> text{}; // longer than any value
    std::ranges::copy(value, text.begin());
    if (!std::strstr(text.data(), "FRU"))
        return std::nullopt;
    const char* number = text.data() + fru_in_value;
    return String(number, ::strnlen(number, fru_size));
}

String find_fru(Data data, std::size_t limit)
{
    for (std::size_t at = keywords_at; at < limit && at + keyword_head <= data.size();)
    {
        const std::size_t length = data[at + 2];
        if (data[at] == 'V' && std::isalnum(data[at + 1]))
        {
            if (const auto fru = fru_of(part_of(data, at + keyword_head, length)))
                return *fru;
        }
        at += keyword_head + length;
    }
    return String();
}

} // namespace

String getFRUNumber(const hxa_mfg_vpd_t& vpd)
{
    const Scope_Trace trace(log_source);
    const Data data(vpd.data);
    if (vpd.vendor == plain_layout)
        return text_of(data.subspan(plain_fru_at));

    const std::size_t stated = data[section_length_at] + std::size_t{256} * data[section_length_at + 1] + keywords_at;
    const std::size_t limit = std::min(stated, data.size());
    if (const char* fault = fault_of(data, limit))
    {
        ZMLR_LOG(LL_ERR, "%s", fault);
        return String();
    }
    return find_fru(data, limit);
}

} // namespace zmlr
