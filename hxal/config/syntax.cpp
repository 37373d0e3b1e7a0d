#include "hxal/config/syntax.h"

#include "hxal/config/internal/syntax.h"

#include <climits>
#include <cstring>

namespace hxal::config
{

namespace
{

bool is_digit(char character) { return character >= '0' && character <= '9'; }

void write_bytes(char* text, const uint8_t* bytes, std::size_t count)
{
    constexpr char digits[] = "0123456789abcdef";
    for (std::size_t i = 0; i < count; ++i)
    {
        *text++ = digits[bytes[i] >> 4];
        *text++ = digits[bytes[i] & 0xF];
        *text++ = i + 1 < count ? ':' : '\0';
    }
}

} // namespace

std::string_view filtered(std::string_view text)
{
    constexpr std::string_view dropped = " \t\";\n";
    const std::size_t first = text.find_first_not_of(dropped);
    if (first == text.npos)
        return " ";
    return text.substr(first, text.find_last_not_of(dropped) + 1 - first);
}

std::optional<std::string_view> raw_key(char start, char end, std::string_view line)
{
    if (start == '-')
    {
        const auto behind = raw_data('-', line);
        if (!behind)
            return {};
        line = *behind;
    }
    const std::size_t length = line.find(end);
    if (length == line.npos || length == 0)
        return {};
    return line.substr(0, length);
}

std::optional<std::string_view> raw_data(char token, std::string_view line)
{
    const std::size_t at = line.find(token);
    if (at == line.npos)
        return {};
    return line.substr(at + 1);
}

int number(std::string_view text)
{
    int64_t value = 0;
    int64_t weight = 1;
    for (; !text.empty() && (is_digit(text.back()) || text.back() == '\n'); text.remove_suffix(1))
    {
        if (text.back() == '\n')
            continue;
        value = std::min<int64_t>(value + (text.back() - '0') * weight, INT_MAX);
        weight = std::min<int64_t>(weight * 10, INT64_C(10'000'000'000));
    }
    return static_cast<int>(value);
}

bool has_number(std::string_view text)
{
    const std::size_t last = text.find_last_not_of('\n');
    return last != text.npos && is_digit(text[last]);
}

uint32_t hexadecimal(std::string_view text, uint32_t value)
{
    for (char digit : text)
        value = value << 4 | xtod(digit);
    return value;
}

wwn_t wwn_of(std::string_view text)
{
    uint8_t bytes[sizeof(wwn_t)] = {};
    std::size_t count = 0;
    split(text, ':',
          [&](std::string_view part)
          {
              if (!part.empty() && count < sizeof bytes)
                  bytes[count++] = static_cast<uint8_t>(hexadecimal(part));
          });
    wwn_t wwn;
    std::memcpy(&wwn, bytes, sizeof wwn);
    return wwn;
}

uint32_t bitmap(std::string_view list)
{
    uint32_t bits = 0;
    split(list, ',',
          [&](std::string_view part)
          {
              const int position = number(part);
              if (part.find_first_not_of(' ') != part.npos)
                  bits |= listtobmp(&position, 1);
          });
    return bits;
}

void write_wwn(char (&text)[wwn_text_size], wwn_t wwn)
{
    uint8_t bytes[sizeof wwn];
    std::memcpy(bytes, &wwn, sizeof wwn);
    write_bytes(text, bytes, sizeof bytes);
}

void write_mac(char (&text)[mac_text_size], const mac_t& mac) { write_bytes(text, mac.mac, sizeof mac.mac); }

} // namespace hxal::config

namespace
{

void copy_out(std::string_view text, char* buffer)
{
    if (!buffer)
        return;
    std::memmove(buffer, text.data(), text.size());
    buffer[text.size()] = '\0';
}

// The scratch buffer first: the filtered view looks into the line, which a caller may give as either buffer.
void store_filtered(std::optional<std::string_view> raw, char* tmp, char* out)
{
    if (!raw)
        return;
    const std::string_view text = hxal::config::filtered(*raw);
    if (tmp != out)
        copy_out(*raw, tmp);
    copy_out(text, out);
}

} // namespace

int hxal_getline(char* line, int size, FILE* file)
{
    if (!line || size < 1 || !file)
        return 0;
    int length = 0;
    for (int character = 0; character != '\n' && length < size - 1; ++length)
    {
        character = ::getc(file);
        if (character == EOF)
            break;
        line[length] = static_cast<char>(character);
    }
    line[length] = '\0';
    return length;
}

void hxal_config_filter_space(const char* in, char* out) { copy_out(hxal::config::filtered(hxal::config::view_of(in)), out); }

void hxal_config_get_key(char start, char end, const char* line, char* tmp, char* key)
{
    store_filtered(hxal::config::raw_key(start, end, hxal::config::view_of(line)), tmp, key);
}

void hxal_config_get_data(char token, const char* line, char* tmp, char* value)
{
    store_filtered(hxal::config::raw_data(token, hxal::config::view_of(line)), tmp, value);
}

int hxal_config_get_num(const char* text) { return text ? hxal::config::number(text) : -1; }

unsigned xtod(char digit)
{
    if (digit >= '0' && digit <= '9')
        return static_cast<unsigned>(digit - '0');
    if (digit >= 'A' && digit <= 'F')
        return static_cast<unsigned>(digit - 'A' + 10);
    if (digit >= 'a' && digit <= 'f')
        return static_cast<unsigned>(digit - 'a' + 10);
    return 0;
}

unsigned HextoDec(const char* text, unsigned value) { return hxal::config::hexadecimal(hxal::config::view_of(text), value); }
unsigned xstrtoi(const char* text) { return HextoDec(text, 0); }

uint32_t listtobmp(const int* list, int n)
{
    uint32_t bmp = 0;
    for (int i = 0; list && i < n; ++i)
        bmp |= uint32_t{1} << (static_cast<unsigned>(list[i]) % 32);
    return bmp;
}

int bmptolist(uint32_t bmp, int* list, int n)
{
    int count = 0;
    for (int position = 0; position < 32 && list && count < n; ++position)
        if (bmp >> position & 1)
            list[count++] = position;
    return count;
}

wwn_t wwn_convert(const char* text) { return hxal::config::wwn_of(hxal::config::view_of(text)); }
