// Any bytes given as what cards, modules and disks deliver: read within their bounds, into terminated texts.
#include "inventory/fru_number.h"
#include "inventory/scsi_pages.h"
#include "inventory/sfp_info.h"

#include <algorithm>
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

template <std::size_t N> void expect_terminated(const char (&text)[N])
{
    if (!std::memchr(text, '\0', N))
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    if (getFRUNumber(block_of<hxa_mfg_vpd_t>(data, size)).size() > sizeof(hxa_mfg_vpd_t::data))
        std::abort();

    const _sfpInfo module = sfp_info(block_of<sfp_mem_t>(data, size), size % 2 == 0, 1, 0);
    expect_terminated(module.tag);
    expect_terminated(module.media);

    _hbaLunInfo lun;
    fill_inquiry(lun, block_of<Inquiry_Data>(data, size));
    fill_identifier(lun, block_of<Identification_Page>(data, size));
    fill_serial_number(lun, block_of<Serial_Page>(data, size));
    expect_terminated(lun.identifier);
    expect_terminated(lun.serial_number);
    return 0;
}
