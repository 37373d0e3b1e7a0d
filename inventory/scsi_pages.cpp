#include "inventory/scsi_pages.h"

#include "inventory/address_text.h"
#include "inventory/property_text.h"
#include "runtime/log.h"

#include <algorithm>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "TargetHelper";

// Positions in the answers.
constexpr std::size_t vendor_at = 8;
constexpr std::size_t product_at = 16;
constexpr std::size_t page_length_at = 3;
constexpr std::size_t page_data_at = 4;
constexpr std::size_t designator_head = 4;

constexpr std::size_t max_identifier = 32; // bytes: what page 83h has room for
static_assert(page_data_at + designator_head + max_identifier == identification_page_size);

constexpr std::uint8_t code_set_binary = 1;

bool is_used(std::uint32_t identifier_type)
{
    return identifier_type == IDENTIFIER_T10_VENDOR_ID || identifier_type == IDENTIFIER_EUI_64 ||
           identifier_type == IDENTIFIER_NAA || identifier_type == IDENTIFIER_SCSI_NAME;
}

const char* text_at(std::span<const std::uint8_t> data, std::size_t position)
{
    return reinterpret_cast<const char*>(data.data()) + position;
}

} // namespace

bool is_tape_device(const Inquiry_Data& data)
{
    constexpr std::uint8_t sequential_access = 1;
    constexpr std::uint8_t medium_changer = 8;
    const std::uint8_t type = data[0] & 0x1F;
    return type == sequential_access || type == medium_changer;
}

void fill_inquiry(_hbaLunInfo& info, const Inquiry_Data& data)
{
    copy_text(info.vendor, sizeof info.vendor, text_at(data, vendor_at), 8);
    copy_text(info.product, sizeof info.product, text_at(data, product_at), 16);
}

bool fill_identifier(_hbaLunInfo& info, const Identification_Page& page)
{
    const auto designator = std::span(page).subspan<page_data_at>();
    const std::uint8_t code_set = designator[0] & 0x0F;
    const std::uint32_t type = designator[1] & 0x0F;
    const std::size_t length = designator[3];
    ZMLR_LOG(LL_INFO, "devIdentPage.desc.id_type= %d.", static_cast<int>(type));
    ZMLR_LOG(LL_INFO, "devIdentPage.page_length= %d.", page[page_length_at]);
    ZMLR_LOG(LL_INFO, "devIdentPage.desc.code_set= %d.", code_set);
    ZMLR_LOG(LL_INFO, "devIdentPage.desc.id_len= %d.", static_cast<int>(length));
    if (!is_used(type))
    {
        ZMLR_LOG(LL_INFO, "Need to get SerialNumber for SNVM");
        return false;
    }

    const auto identifier = designator.subspan(designator_head, std::min(length, max_identifier));
    if (code_set == code_set_binary)
        ProviderUtil::write_hex(info.identifier, identifier);
    else
    {
        if (length > max_identifier)
            ZMLR_LOG(LL_INFO, "Setting len to 32 as its not expected to have more than 32 byte values");
        copy_text(info.identifier, sizeof info.identifier, text_at(identifier, 0), identifier.size());
    }
    info.identifier_type = type;
    return true;
}

void fill_serial_number(_hbaLunInfo& info, const Serial_Page& page)
{
    const std::size_t length = std::min<std::size_t>(page[page_length_at], page.size() - page_data_at);
    copy_text(info.serial_number, sizeof info.serial_number, text_at(page, page_data_at), length);
    info.identifier_type = IDENTIFIER_SERIAL_NUMBER;
}

std::uint32_t lun_count(std::span<const std::uint8_t> list)
{
    const std::uint32_t length =
        std::uint32_t{list[0]} << 24 | std::uint32_t{list[1]} << 16 | std::uint32_t{list[2]} << 8 | list[3];
    return length / lun_entry_size;
}

} // namespace zmlr
