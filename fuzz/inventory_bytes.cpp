// Any bytes given as what cards, modules and disks deliver: read within their bounds, into texts that clients can be shown.
#include "inventory/fru_number.h"
#include "inventory/port_statistics.h"
#include "inventory/property_text.h"
#include "inventory/scsi_pages.h"
#include "inventory/sfp_info.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>
#include <cstring>

namespace
{

using namespace zmlr;

template <class Block> Block block_of(const uint8_t* data, std::size_t size)
{
    Block block{};
    std::memcpy(&block, data, std::min(size, sizeof block));
    return block;
}

void expect(bool holds)
{
    if (!holds)
        std::abort();
}

// A field as clients see it: nothing in it is to be replaced any more.
template <std::size_t N> String shown(const char (&field)[N])
{
    expect(std::memchr(field, '\0', N) != nullptr);
    const String text = property_text(field);
    expect(property_text(text.c_str(), text.size()) == text);
    return text;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    expect(getFRUNumber(block_of<hxa_mfg_vpd_t>(data, size)).size() <= sizeof(hxa_mfg_vpd_t::data));

    const _sfpInfo module = sfp_info(block_of<sfp_mem_t>(data, size), size % 2 == 0, 1, 0);
    expect(shown(module.tag) == shown(module.serial_number) + "_1_0");
    for (const String& text : {shown(module.vendor_name), shown(module.part_number), shown(module.revision)})
        expect(text.empty() || (text[0] != ' ' && text[text.size() - 1] != ' '));
    shown(module.kind);
    shown(module.media);

    _hbaLunInfo lun;
    const auto inquiry = block_of<Inquiry_Data>(data, size);
    fill_inquiry(lun, inquiry);
    shown(lun.vendor);
    shown(lun.product);
    expect(!fill_identifier(lun, block_of<Identification_Page>(data, size)) || lun.identifier_type != 0);
    fill_serial_number(lun, block_of<Serial_Page>(data, size));
    shown(lun.identifier);
    shown(lun.serial_number);
    is_tape_device(inquiry);
    expect(lun_count(inquiry) <= UINT32_MAX / lun_entry_size);

    const auto counters = block_of<std::array<hxal_stats_long_t, HXAL_ETH_PORT_STATS>>(data, size);
    const uint64 received = fc_port_statistics(counters).fc.rx_frames;
    expect(received == 0 || std::ranges::find(counters, received, &hxal_stats_long_t::value) != counters.end());
    eth_port_statistics(counters);
    return 0;
}
