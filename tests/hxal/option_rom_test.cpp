#include "hxal/internal/option_rom.h"

#include "tests/hxal/boot_files.h"

#include <gtest/gtest.h>

#include <numeric>

namespace
{

uint16_t word_at(const Bytes& bytes, size_t at) { return static_cast<uint16_t>(bytes[at] | bytes[at + 1] << 8); }

uint8_t sum(const Bytes& bytes, size_t from, size_t size)
{
    const auto first = bytes.begin() + static_cast<ptrdiff_t>(from);
    return static_cast<uint8_t>(std::accumulate(first, first + static_cast<ptrdiff_t>(size), 0u));
}

constexpr uint8_t efi_code = 3;

const Bytes chain = joined(Rom{.code_type = efi_code, .last = false}.build(), Rom{}.build());

TEST(OptionRom, writes_the_device_id_and_all_checksums_into_every_image_of_a_patched_card)
{
    for (const uint16_t devid : std::initializer_list<uint16_t>{0x14, 0x17, 0x21})
    {
        Bytes rom = chain;
        EXPECT_EQ(hxal::update_device_id_chksum(rom, devid), HXA_STATUS_OK);
        EXPECT_EQ(word_at(rom, 64 + 6), devid);
        EXPECT_EQ(word_at(rom, 128 + 12), 0x13) << "no x86 code, no Plug and Play header";
        EXPECT_EQ(word_at(rom, 1024 + 64 + 6), devid);
        EXPECT_EQ(word_at(rom, 1024 + 128 + 12), devid);
        EXPECT_EQ(sum(rom, 1024 + 128, 32), 0);
        EXPECT_EQ(sum(rom, 0, 1024), 0);
        EXPECT_EQ(sum(rom, 1024, 1024), 0);
    }
}

TEST(OptionRom, of_another_card_stays_as_it_is_from_the_first_x86_image_on)
{
    Bytes rom = chain;
    EXPECT_EQ(hxal::update_device_id_chksum(rom, 0x13), HXA_STATUS_OK);
    Bytes expected = chain;
    expected[1023] = static_cast<uint8_t>(expected[1023] - sum(chain, 0, 1024));
    EXPECT_EQ(rom, expected);

    const Bytes odd = Rom{.pnp_units = 0}.build();
    rom = odd;
    EXPECT_EQ(hxal::update_device_id_chksum(rom, 0x13), HXA_STATUS_OK) << "there is a Plug and Play header, read by nobody";
    EXPECT_EQ(rom, odd);
    rom = Rom{.pnp_header = 0}.build();
    EXPECT_EQ(hxal::update_device_id_chksum(rom, 0x13), HXA_STATUS_FAILED);
}

TEST(OptionRom, with_a_structure_out_of_place_is_refused)
{
    const Bytes rows[] = {
        {},
        Bytes(27, 0),
        Rom{.data_structure = 1024 - 21}.build(),
        Rom{.data_structure = 0xFFFF}.build(),
        Rom{.units = 0}.build(),              // a chain that stands still
        Rom{.units = 3}.build(),              // longer than the ROM
        Rom{.last = false}.build(),           // a chain without end
        Rom{.pnp_header = 0}.build(),         // none
        Rom{.pnp_header = 1024 - 15}.build(), // cut
        Rom{.pnp_units = 0}.build(),          // shorter than its fields
        Rom{.pnp_units = 57}.build(),         // reaches out of the image
    };
    for (const Bytes& row : rows)
    {
        Bytes rom = row;
        EXPECT_EQ(hxal::update_device_id_chksum(rom, 0x17), HXA_STATUS_FAILED) << testing::PrintToString(&row - rows);
    }
}

TEST(OptionRom, words_are_reversed_one_by_one)
{
    Bytes bytes = {1, 2, 3, 4, 5, 6, 7, 8, 9, 10};
    hxal::reverse_words(bytes);
    EXPECT_EQ(bytes, (Bytes{4, 3, 2, 1, 8, 7, 6, 5, 9, 10}));
}

} // namespace
