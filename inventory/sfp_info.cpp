#include "inventory/sfp_info.h"

#include "inventory/address_text.h"

#include <cstdio>
#include <span>

namespace zmlr
{

namespace
{

// A bit of a compliance byte, and what it stands for.
struct Compliance
{
    int bit;
    const char* text;
};

// SFF-8472, transceiver compliance codes, bytes 3 and 10.
constexpr Compliance ethernet_compliance[] = {{4, "10G_BASE-SR"}, {5, "10G_BASE-LR"}, {6, "10G_BASE-LRM"}};
constexpr Compliance fc_compliance[] = {{0, "100"}, {2, "200"}, {4, "400"}, {6, "800"}, {7, "1200"}};

String texts_of(std::uint8_t bits, std::span<const Compliance> table, const char* separator)
{
    String texts;
    for (const Compliance& row : table)
    {
        if (!(bits >> row.bit & 1))
            continue;
        if (!texts.empty())
            texts.append(separator);
        texts.append(row.text);
    }
    return texts;
}

const char* kind_of(std::uint8_t identifier)
{
    switch (identifier)
    {
    case 1:
        return "GBIC";
    case 3:
        return "SFP";
    default:
        return "Unknown";
    }
}

} // namespace

_sfpInfo sfp_info(const sfp_mem_t& memory, bool is_cna, int adapter, int port)
{
    const sfp_serial_id_base_t& base = memory.serial_id_base;
    _sfpInfo info;
    ProviderUtil::copy_trimmed(info.vendor_name, base.vendor_name);
    ProviderUtil::copy_trimmed(info.part_number, base.vendor_pn);
    ProviderUtil::copy_trimmed(info.serial_number, memory.serial_id_ext.vendor_sn);
    ProviderUtil::copy_trimmed(info.revision, base.vendor_rev);
    std::snprintf(info.tag, sizeof info.tag, "%s_%d_%d", info.serial_number, adapter, port);
    std::snprintf(info.kind, sizeof info.kind, "%s", kind_of(base.identifier));
    std::snprintf(info.media, sizeof info.media, "%s", (is_cna ? ethernet_media(memory) : fc_media(memory)).c_str());
    return info;
}

String ethernet_media(const sfp_mem_t& memory) { return texts_of(memory.serial_id_base.xcvr[0], ethernet_compliance, ""); }

String fc_media(const sfp_mem_t& memory) { return texts_of(memory.serial_id_base.xcvr[7], fc_compliance, ","); }

} // namespace zmlr
