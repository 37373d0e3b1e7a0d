#include "inventory/address_text.h"

#include "inventory/property_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

#include <algorithm>
#include <cstring>
#include <span>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";

int hex_value(char digit)
{
    if (digit >= '0' && digit <= '9')
        return digit - '0';
    const char lower = static_cast<char>(digit | 0x20);
    return lower >= 'a' && lower <= 'f' ? lower - 'a' + 10 : -1;
}

bool read_hex(const char* text, std::span<unsigned char> out)
{
    for (unsigned char& byte : out)
    {
        const int high = hex_value(text[0]);
        const int low = high < 0 ? -1 : hex_value(text[1]);
        if (low < 0)
        {
            std::memset(out.data(), 0, out.size());
            return false;
        }
        byte = static_cast<unsigned char>(high << 4 | low);
        text += 2;
    }
    return true;
}

// The models by the kind of address in their packages' tags.
constexpr const char* cna_models[] = {"Zemlar-C10", "Zemlar-C20", "Zemlar-C07"};
constexpr const char* fc_models[] = {"Zemlar-F15", "Zemlar-F25", "Zemlar-F85", "Zemlar-F86"};

bool is_one_of(std::span<const char* const> models, const String& model)
{
    for (const char* name : models)
    {
        if (model.equali(name))
            return true;
    }
    return false;
}

// At most n characters of a tag from pos on: what there is of them.
String part_of(const String& tag, uint32 pos, uint32 n)
{
    return pos < tag.size() ? tag.substr(pos, std::min(n, tag.size() - pos)) : String();
}

} // namespace

void ProviderUtil::WWN2str(char* out, const wwn_t* wwn)
{
    const Scope_Trace trace(log_source);
    write_hex(out, {reinterpret_cast<const unsigned char*>(wwn), sizeof *wwn});
    ZMLR_LOG(LL_INFO, "WWN: %s\n", out);
}

void ProviderUtil::MAC2str(char* out, const mac_t* mac)
{
    const Scope_Trace trace(log_source);
    write_hex(out, mac->mac);
}

String ProviderUtil::wwn_text(wwn_t wwn)
{
    char text[wwn_text_size];
    WWN2str(text, &wwn);
    return text;
}

String ProviderUtil::mac_text(const mac_t& mac)
{
    char text[mac_text_size];
    MAC2str(text, &mac);
    return text;
}

void ProviderUtil::write_hex(char* out, std::span<const unsigned char> bytes)
{
    constexpr const char* digits = "0123456789ABCDEF";
    for (const unsigned char byte : bytes)
    {
        *out++ = digits[byte >> 4];
        *out++ = digits[byte & 0xF];
    }
    *out = '\0';
}

bool ProviderUtil::getRawWWNFromStr(const char* text, unsigned char* out)
{
    const Scope_Trace trace(log_source);
    return read_hex(text, {out, sizeof(wwn_t)});
}

bool ProviderUtil::getRawMacFromStr(const char* text, unsigned char* out)
{
    const Scope_Trace trace(log_source);
    return read_hex(text, {out, sizeof(mac_t)});
}

String ProviderUtil::getNodeMACOrWWNFromTag(const String& tag, const String& model)
{
    const Scope_Trace trace(log_source);
    constexpr uint32 first_digits = 19; // of a WWN; a MAC address has zeros there
    constexpr uint32 last_digits = 24;

    if (is_one_of(cna_models, model))
        return part_of(tag, last_digits, tag.size());
    if (is_one_of(fc_models, model))
        return part_of(tag, first_digits, 4) + part_of(tag, last_digits, tag.size());
    return String();
}

void ProviderUtil::trimString(const char* in, char* out)
{
    const Scope_Trace trace(log_source);
    ZMLR_LOG(LL_INFO, "Input String (string) = %s", in);

    const char* begin = in + std::strspn(in, " ");
    const char* end = begin + std::strlen(begin);
    while (end > begin && end[-1] == ' ')
        end--;
    const auto length = static_cast<std::size_t>(end - begin);
    std::memmove(out, begin, length);
    out[length] = '\0';

    ZMLR_LOG(LL_INFO, "Output String (buf) = %s", out);
}

void ProviderUtil::copy_trimmed(char* out, std::size_t out_size, const char* field, std::size_t size)
{
    copy_text(out, out_size, field, size);
    trimString(out, out);
}

} // namespace zmlr
