#include "hxal/flash.h"

#include "hxal/internal/image.h"
#include "hxal/internal/memory.h"
#include "hxal/internal/request.h"
#include "hxal/library.h"

#include <algorithm>
#include <array>
#include <cstring>

namespace
{

using hxal::Image;

struct Part
{
    hxa_flash_part_type_t type;
    uint8_t instance;
};

// The product line, as hxal_flash_mfg_info() documents it.
constexpr std::array<uint32_t, 8> card_types = {7, 10, 15, 17, 20, 25, 85, 86};

constexpr size_t max_serial_length = 11;
constexpr size_t max_part_number_length = 14;

// A request on a partition, with the bytes that the driver takes or fills.
hxa_ioctl_flash_t part_request(const hxal_t& ioc, Part part, const Image& bytes)
{
    auto record = hxal::request_for<hxa_ioctl_flash_t>(ioc);
    record.type = part.type;
    record.instance = part.instance;
    record.buf_ptr = hxal::sender_address(bytes.data());
    record.bufsz = static_cast<int32_t>(bytes.size());
    return record;
}

hxa_status_t verify_part(const hxal_t& ioc, Part part, const Image& written)
{
    Image found(written.size());
    auto record = part_request(ioc, part, found);
    if (const hxa_status_t read = hxal::exchange(ioc, "IOCMD_FLASH_READ_PART", record); read != HXA_STATUS_OK)
        return read;
    return found == written ? HXA_STATUS_OK : HXA_STATUS_FAILED;
}

// Whether the 32-bit words of a firmware image cancel out, as those of every good one do.
bool cancels_out(const Image& firmware)
{
    const auto* words = reinterpret_cast<const uint32_t*>(firmware.data());
    return hxa_checksum_u32(words, static_cast<int>(firmware.size())) == 0;
}

hxa_status_t update_part(const hxal_t& ioc, Part part, const Image& image)
{
    if (part.type == HXA_FLASH_PART_FWIMG && !cancels_out(image))
        return HXA_STATUS_CHECKSUM_FAIL;
    auto record = part_request(ioc, part, image);
    if (const hxa_status_t written = hxal::exchange(ioc, "IOCMD_FLASH_UPDATE_PART", record); written != HXA_STATUS_OK)
        return written;
    return verify_part(ioc, part, image);
}

} // namespace

hxa_status_t hxal_flash_get_attr(const hxal_t* ioc, hxa_flash_attr_t* attr)
{
    return hxal::read(ioc, "IOCMD_FLASH_GET_ATTR", &hxa_ioctl_flash_attr_t::attr, attr);
}

hxa_status_t hxal_flash_erase_part(const hxal_t* ioc, hxa_flash_part_type_t type, uint8_t instance)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = part_request(*ioc, {type, instance}, {});
    return hxal::exchange(*ioc, "IOCMD_FLASH_ERASE_PART", record);
}

hxa_status_t hxal_flash_read_part(const hxal_t* ioc, hxa_flash_part_type_t type, uint8_t instance, char* dest, uint32_t size,
                                  hxa_boolean_t bfile)
{
    if (!ioc || !dest)
        return HXA_STATUS_EINVAL;
    if (size > hxal::max_image_size)
        return HXA_STATUS_ENOMEM;
    return hxal::within_memory(
        [&]
        {
            Image image(size);
            auto record = part_request(*ioc, {type, instance}, image);
            if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_FLASH_READ_PART", record); sent != HXA_STATUS_OK)
                return sent;
            if (bfile)
                return record.status == HXA_STATUS_OK ? hxal::write_image_file(dest, image) : record.status;
            std::copy(image.begin(), image.end(), dest);
            return record.status;
        });
}

hxa_status_t hxal_flash_update_part(const hxal_t* ioc, hxa_flash_part_type_t type, uint8_t instance, const unsigned char* src,
                                    hxa_boolean_t bfile, uint32_t size)
{
    if (!ioc || !src)
        return HXA_STATUS_EINVAL;
    if (!bfile && size > hxal::max_image_size)
        return HXA_STATUS_ENOMEM;
    return hxal::within_memory(
        [&]
        {
            if (!bfile)
                return update_part(*ioc, {type, instance}, Image(src, src + size));
            Image image;
            const hxa_status_t read = hxal::read_image_file(reinterpret_cast<const char*>(src), image);
            return read == HXA_STATUS_OK ? update_part(*ioc, {type, instance}, image) : read;
        });
}

hxa_status_t hxal_flash_mfg_info(const hxal_t* ioc, const char* serial, const char* partnum, wwn_t wwn, mac_t mac,
                                 uint32_t card_type)
{
    if (!ioc || !serial || !partnum || std::find(card_types.begin(), card_types.end(), card_type) == card_types.end())
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_flash_mfg_t>(*ioc);
    hxa_mfg_block_t& block = record.mfg_block;
    std::memcpy(block.zmlr_serialnum, serial, ::strnlen(serial, max_serial_length));
    std::memcpy(block.zmlr_partnum, partnum, ::strnlen(partnum, max_part_number_length));
    block.mfgsize = sizeof block;
    block.mfg_wwn = wwn;
    block.mfg_mac = mac;
    block.mfg_type = card_type;
    return hxal::exchange(*ioc, "IOCMD_FLASH_MFG_INFO", record);
}

hxa_status_t hxal_flash_enable_optrom(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_FLASH_ENABLE_OPTROM"); }
hxa_status_t hxal_flash_disable_optrom(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_FLASH_DISABLE_OPTROM"); }
