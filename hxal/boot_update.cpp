#include "hxal/boot.h"

#include "hxal/adapter.h"
#include "hxal/flash.h"
#include "hxal/internal/boot_archive.h"
#include "hxal/internal/memory.h"
#include "hxal/internal/option_rom.h"
#include "hxal/library.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace
{

using hxal::HXAL_IMAGE_DATA_T;
using Images = std::vector<HXAL_IMAGE_DATA_T>;

// The cards that take boot code, by PCI device id.
constexpr std::array<uint16_t, 4> known_devices = {0x13, 0x14, 0x17, 0x21};

bool is_known(uint16_t devid) { return std::find(known_devices.begin(), known_devices.end(), devid) != known_devices.end(); }
bool has_optrom_switch(uint16_t devid) { return devid == 0x13 || devid == 0x17; }

hxa_status_t write_part(const hxal_t& ioc, const HXAL_IMAGE_DATA_T& image, const hxal::Image& bytes, uint8_t instance)
{
    const auto type = static_cast<hxa_flash_part_type_t>(image.itype);
    return hxal_flash_update_part(&ioc, type, instance, bytes.data(), HXA_FALSE, static_cast<uint32_t>(bytes.size()));
}

hxa_status_t write_configuration(const hxal_t& ioc, const HXAL_IMAGE_DATA_T& image)
{
    for (const uint8_t instance : image.iport)
        if (const hxa_status_t written = write_part(ioc, image, image.ibuf, instance); written != HXA_STATUS_OK)
            return written;
    return HXA_STATUS_OK;
}

// The cards keep code for the host with the bytes of its words reversed.
hxa_status_t write_host_code(const hxal_t& ioc, const HXAL_IMAGE_DATA_T& image, uint16_t devid)
{
    hxal::Image copy = image.ibuf;
    if (image.itype == hxal::image_option_rom)
        if (const hxa_status_t fitted = hxal::update_device_id_chksum(copy, devid); fitted != HXA_STATUS_OK)
            return fitted;
    hxal::reverse_words(copy);
    return write_part(ioc, image, copy, 0);
}

hxa_status_t write_image(const hxal_t& ioc, const HXAL_IMAGE_DATA_T& image, uint16_t devid)
{
    switch (image.itype)
    {
    case hxal::image_ignored:
        return HXA_STATUS_OK;
    case hxal::image_option_rom:
    case hxal::image_boot_overlay:
        return write_host_code(ioc, image, devid);
    case hxal::image_firmware_configuration:
        return write_configuration(ioc, image);
    case hxal::image_firmware:
        break;
    }
    return write_part(ioc, image, image.ibuf, 0);
}

hxa_status_t flash_data(const hxal_t& ioc, const Images& images, uint16_t devid)
{
    const auto is_for_card = [=](const HXAL_IMAGE_DATA_T& image) { return image.is_for(devid); };
    if (std::none_of(images.begin(), images.end(), is_for_card))
        return HXA_STATUS_DEVID_MISSING;
    for (const HXAL_IMAGE_DATA_T& image : images)
        if (is_for_card(image))
            if (const hxa_status_t written = write_image(ioc, image, devid); written != HXA_STATUS_OK)
                return written;
    return has_optrom_switch(devid) ? hxal_flash_enable_optrom(&ioc) : HXA_STATUS_OK;
}

hxa_status_t read_device_id(const hxal_t& ioc, uint16_t& devid)
{
    hxa_ioc_attr_t attributes;
    const hxa_status_t read = hxal_ioc_get_attr(&ioc, &attributes);
    if (read == HXA_STATUS_OK)
        devid = attributes.pci_attr.device_id;
    return read;
}

// One card of an update of every card; tells how it goes.
hxa_status_t update_listed_card(int ad, const hxal_t& ioc, const Images& images, uint16_t devid)
{
    std::printf("updating boot code for adapter id %d\n", ad);
    const hxa_status_t updated = flash_data(ioc, images, devid);
    if (updated == HXA_STATUS_OK)
        std::printf("updated boot code for adapter id %d\n", ad);
    else if (updated == HXA_STATUS_DEVID_MISSING)
        hxal_set_last_error(updated);
    else
        std::printf("boot code update failed for adapter id %d, exiting...\n", ad);
    return updated;
}

hxa_status_t update_every_card(const Images& images)
{
    const int count = static_cast<int>(hxal_adapter_get_num());
    int updated = 0;
    hxa_status_t last = HXA_STATUS_OK;
    std::printf("found %d adapters, uploading boot code...\n", count);
    for (int ad = 1; ad <= count && (last == HXA_STATUS_OK || last == HXA_STATUS_DEVID_MISSING); ++ad)
    {
        const hxal_t* ioc = hxal_adapter_get_port(ad);
        if (!ioc)
            continue;
        uint16_t devid = 0;
        if (const hxa_status_t read = read_device_id(*ioc, devid); read != HXA_STATUS_OK)
            return read;
        last = update_listed_card(ad, *ioc, images, devid);
        updated += last == HXA_STATUS_OK;
    }
    std::printf("updated boot code for %d out of %d adapters\n", updated, count);
    return last;
}

} // namespace

hxa_status_t hxal_boot_fwupdate(const hxal_t* ioc, const char* file, uint16_t devid)
{
    if (!file)
        return HXA_STATUS_EINVAL;
    if (devid != 0 && !is_known(devid))
        return HXA_STATUS_INVALID_DEVID;
    if (ioc && devid == 0)
        read_device_id(*ioc, devid);
    return hxal::within_memory(
        [&]
        {
            Images images;
            if (const hxa_status_t read = hxal::read_boot_archive(file, images); read != HXA_STATUS_OK)
                return read;
            return ioc ? flash_data(*ioc, images, devid) : update_every_card(images);
        });
}
