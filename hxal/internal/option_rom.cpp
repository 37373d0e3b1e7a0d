#include "hxal/internal/option_rom.h"

#include "hxal/internal/option_rom_layout.h"
#include "hxal/library.h"

#include <algorithm>
#include <span>

namespace hxal
{

namespace
{

constexpr size_t image_length_unit = 512;
constexpr size_t pnp_length_unit = 16;
constexpr uint8_t x86_code = 0;
constexpr uint8_t last_image = 0x80;

using Bytes = std::span<uint8_t>;

uint16_t word_at(Bytes bytes, size_t offset) { return static_cast<uint16_t>(bytes[offset] | bytes[offset + 1] << 8); }

void put_word(Bytes bytes, size_t offset, uint16_t word)
{
    bytes[offset] = static_cast<uint8_t>(word);
    bytes[offset + 1] = static_cast<uint8_t>(word >> 8);
}

// The bytes from an offset on; empty unless there are at least `size`.
Bytes structure_at(Bytes bytes, size_t offset, size_t size)
{
    return offset <= bytes.size() && bytes.size() - offset >= size ? bytes.subspan(offset) : Bytes();
}

// Makes the bytes add up to 0 modulo 256 by the one at `at`.
void put_checksum(Bytes bytes, size_t at)
{
    bytes[at] = 0;
    bytes[at] = static_cast<uint8_t>(hxal_checksum_u8(bytes.data(), static_cast<uint32_t>(bytes.size())));
}

bool is_patched(uint16_t devid) { return devid == 0x14 || devid == 0x17 || devid == 0x21; }

// What stands in an image from its Plug and Play header on; empty when there is none.
Bytes pnp_header_of(Bytes image)
{
    const size_t offset = word_at(image, offsetof(pci_optrom_hdr_t, pnphdr));
    return offset == 0 ? Bytes() : structure_at(image, offset, pnp_length_unit);
}

// False when the header is shorter than its fields or longer than the image.
bool patch_pnp_header(Bytes rest, uint16_t devid)
{
    const size_t length = rest[offsetof(pnp_hdr_t, len)] * pnp_length_unit;
    if (length == 0 || length > rest.size())
        return false;
    put_word(rest, offsetof(pnp_hdr_t, pnp_dev_id[1]), devid);
    put_checksum(rest.first(length), offsetof(pnp_hdr_t, cksum));
    return true;
}

// What the walk needs to know of an image before it changes anything.
struct Rom_Image
{
    Bytes bytes; // empty: not all of it is there
    Bytes data_structure;
    bool is_x86 = false;
    bool is_last = false;
};

Rom_Image image_at(Bytes rom, size_t offset)
{
    const Bytes rest = structure_at(rom, offset, sizeof(pci_optrom_hdr_t));
    if (rest.empty())
        return {};
    const Bytes found = structure_at(rest, word_at(rest, offsetof(pci_optrom_hdr_t, pcids)), sizeof(pci_3_0_ds_t));
    const size_t length = found.empty() ? 0 : word_at(found, offsetof(pci_3_0_ds_t, imglen)) * image_length_unit;
    if (length > rest.size())
        return {};
    return {.bytes = rest.first(length),
            .data_structure = found,
            .is_x86 = !found.empty() && found[offsetof(pci_3_0_ds_t, codetype)] == x86_code,
            .is_last = !found.empty() && (found[offsetof(pci_3_0_ds_t, indr)] & last_image) != 0};
}

} // namespace

hxa_status_t update_device_id_chksum(Image& rom, uint16_t devid)
{
    const bool patched = is_patched(devid);
    for (size_t offset = 0;;)
    {
        const Rom_Image image = image_at(rom, offset);
        if (image.bytes.empty())
            return HXA_STATUS_FAILED;
        if (patched)
            put_word(image.data_structure, offsetof(pci_3_0_ds_t, devid), devid);
        if (image.is_x86)
        {
            const Bytes header = pnp_header_of(image.bytes);
            if (header.empty())
                return HXA_STATUS_FAILED;
            if (!patched)
                return HXA_STATUS_OK;
            if (!patch_pnp_header(header, devid))
                return HXA_STATUS_FAILED;
        }
        put_checksum(image.bytes, image.bytes.size() - 1);
        if (image.is_last)
            return HXA_STATUS_OK;
        offset += image.bytes.size();
    }
}

void reverse_words(Image& image)
{
    for (size_t word = 0; word + 4 <= image.size(); word += 4)
        std::reverse(image.begin() + static_cast<ptrdiff_t>(word), image.begin() + static_cast<ptrdiff_t>(word) + 4);
}

} // namespace hxal
