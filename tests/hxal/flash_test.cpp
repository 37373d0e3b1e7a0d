#include "tests/hxal/library_fixture.h"
#include "tests/support/temporary_folder.h"

#include <iterator>

namespace
{

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::IsEmpty;

// One HBA and a folder for images.
class Flash : public Library_Test, Temporary_Folder
{
protected:
    Flash()
    {
        scan(R"({"adapters": [{"kind": "fc-hba"}]})");
        ioc = hxal_adapter_get_port(1);
    }

    using Temporary_Folder::file, Temporary_Folder::path;

    hxa_status_t update_from_file(const std::string& name, hxa_flash_part_type_t type = HXA_FLASH_PART_PBC) const
    {
        const std::string from = path(name);
        return hxal_flash_update_part(ioc, type, 0, reinterpret_cast<const unsigned char*>(from.c_str()), HXA_TRUE, 0);
    }

    hxa_status_t read_to_file(const std::string& to, uint32_t size) const
    {
        std::string writable = to;
        return hxal_flash_read_part(ioc, HXA_FLASH_PART_PBC, 0, writable.data(), size, HXA_TRUE);
    }

    const hxal_t* ioc;
};

TEST_F(Flash, partition_goes_from_file_to_file)
{
    file("in", "pre-boot");
    EXPECT_EQ(update_from_file("in"), HXA_STATUS_OK);
    const auto sent = hxasim::take_requests();
    ASSERT_EQ(sent.size(), 2u);
    EXPECT_EQ(sent[0].name, "IOCMD_FLASH_UPDATE_PART");
    EXPECT_EQ(sent[1].name, "IOCMD_FLASH_READ_PART");
    for (const auto& request : sent)
    {
        EXPECT_EQ(request.sent[6], 0);
        EXPECT_EQ(request.sent[16], HXA_FLASH_PART_PBC);
        EXPECT_EQ(request.sent[20], 8);
    }
    EXPECT_EQ(read_to_file(path("out"), 10), HXA_STATUS_OK);
    std::ifstream out(path("out"));
    EXPECT_EQ(std::string(std::istreambuf_iterator(out), {}), "pre-boot\xFF\xFF") << "erased behind what was written";
}

TEST_F(Flash, image_that_cannot_be_read_or_is_too_large_is_not_sent)
{
    file("empty", "");
    fs::create_directory(path("folder"));
    fs::resize_file(file("huge", ""), 64 * 1024 * 1024 + 1);
    EXPECT_EQ(update_from_file("missing"), HXA_STATUS_FAILED);
    EXPECT_EQ(update_from_file("empty"), HXA_STATUS_FAILED);
    EXPECT_EQ(update_from_file("folder"), HXA_STATUS_FAILED);
    EXPECT_EQ(update_from_file("huge"), HXA_STATUS_ENOMEM);
    unsigned char image[1];
    EXPECT_EQ(hxal_flash_update_part(ioc, HXA_FLASH_PART_PBC, 0, image, HXA_FALSE, UINT32_MAX), HXA_STATUS_ENOMEM);
    EXPECT_EQ(read_to_file(path("out"), UINT32_MAX), HXA_STATUS_ENOMEM);
    EXPECT_EQ(hxal_flash_update_part(ioc, HXA_FLASH_PART_PBC, 0, nullptr, HXA_FALSE, 1), HXA_STATUS_EINVAL);
    file("firmware", "1234123");
    EXPECT_EQ(update_from_file("firmware", HXA_FLASH_PART_FWIMG), HXA_STATUS_CHECKSUM_FAIL);
    EXPECT_EQ(hxal_flash_mfg_info(ioc, "S", "P", 0, {}, 42), HXA_STATUS_EINVAL);
    EXPECT_THAT(commands(), IsEmpty());
    file("firmware", "12341234123");
    EXPECT_EQ(update_from_file("firmware", HXA_FLASH_PART_FWIMG), HXA_STATUS_OK) << "the last bytes are no word";
}

TEST_F(Flash, read_that_fails_leaves_the_buffer_and_the_file_alone)
{
    char bytes[4] = {1, 2, 3, 4};
    fail("IOCMD_FLASH_READ_PART", EIO);
    EXPECT_EQ(hxal_flash_read_part(ioc, HXA_FLASH_PART_PBC, 0, bytes, 4, HXA_FALSE), HXA_STATUS_EIO);
    EXPECT_THAT(bytes, ElementsAre(1, 2, 3, 4));
    hxasim::clear_faults();
    EXPECT_EQ(read_to_file(path("out"), 4097), HXA_STATUS_FLASH_BAD_LEN);
    EXPECT_FALSE(fs::exists(path("out")));
    EXPECT_EQ(read_to_file(path("no/out"), 4), HXA_STATUS_EFOPEN);
    EXPECT_EQ(read_to_file("/dev/full", 4), HXA_STATUS_FAILED);
}

} // namespace
