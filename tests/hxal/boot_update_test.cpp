#include "tests/hxal/boot_files.h"
#include "tests/hxal/golden.h"
#include "tests/hxal/library_fixture.h"
#include "tests/support/temporary_folder.h"

#include "hxal/internal/boot_description.h"
#include "hxal/internal/option_rom.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <numeric>
#include <thread>

namespace
{

namespace fs = std::filesystem;

const Bytes firmware = []
{
    Bytes bytes(4096);
    std::iota(bytes.begin(), bytes.end(), uint8_t{0}); // every word of the first 256 bytes comes an even number of times
    return bytes;
}();
const Bytes configuration = bytes_of("configuration");
const Bytes overlay = bytes_of("12345678");

const std::string description = golden("boot.txt");

Archive archive_of(const std::string& text, const Bytes& firmware_image = firmware)
{
    return Archive()
        .add("boot.txt", bytes_of(text))
        .add("optrom.bin", Rom{}.build())
        .add("firmware.bin", firmware_image)
        .add("config.bin", configuration)
        .add("overlay.bin", overlay)
        .add("else.bin", bytes_of("else"));
}

// One HBA of two ports with device id 0x13, the library on it, and a folder of its own to be in.
class Boot_Update : public Library_Test, Temporary_Folder
{
protected:
    Boot_Update()
    {
        fs::current_path(folder);
        scan(R"({"adapters": [{"kind": "fc-hba"}]})");
    }

    ~Boot_Update() override { fs::current_path(_before); }

    static hxa_status_t update(const Archive& archive, uint16_t devid = 0)
    {
        archive.save("archive");
        return hxal_boot_fwupdate(hxal_adapter_get_port(1), "archive", devid);
    }

    static Bytes part(hxa_flash_part_type_t type, size_t size, uint8_t instance = 0, int ad = 1)
    {
        Bytes bytes(size);
        EXPECT_EQ(hxal_flash_read_part(hxal_adapter_get_port(ad), type, instance, reinterpret_cast<char*>(bytes.data()),
                                       static_cast<uint32_t>(size), HXA_FALSE),
                  HXA_STATUS_OK);
        return bytes;
    }

    static bool left_nothing() { return std::distance(fs::directory_iterator("."), {}) == 1; }

private:
    const fs::path _before = fs::current_path();
};

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(Boot_Update, writes_and_verifies_every_image_for_the_card_and_switches_the_option_rom_on)
{
    for (const Archive& archive : {archive_of(description), wrapped(archive_of(description))})
    {
        scan(R"({"adapters": [{"kind": "fc-hba"}]})");
        ASSERT_EQ(update(archive), HXA_STATUS_OK);
        EXPECT_THAT(commands(), ElementsAre("IOCMD_IOC_GET_ATTR", "IOCMD_FLASH_UPDATE_PART", "IOCMD_FLASH_READ_PART",
                                            "IOCMD_FLASH_UPDATE_PART", "IOCMD_FLASH_READ_PART", "IOCMD_FLASH_UPDATE_PART",
                                            "IOCMD_FLASH_READ_PART", "IOCMD_FLASH_UPDATE_PART", "IOCMD_FLASH_READ_PART",
                                            "IOCMD_FLASH_UPDATE_PART", "IOCMD_FLASH_READ_PART", "IOCMD_FLASH_ENABLE_OPTROM"));
        Bytes rom = Rom{}.build();
        hxal::reverse_words(rom);
        EXPECT_EQ(part(HXA_FLASH_PART_OPTROM, rom.size()), rom) << "not fitted: 0x13 is the id it comes with";
        EXPECT_EQ(part(HXA_FLASH_PART_FWIMG, firmware.size()), firmware);
        EXPECT_EQ(part(HXA_FLASH_PART_FWCFG, configuration.size(), 0), configuration);
        EXPECT_EQ(part(HXA_FLASH_PART_FWCFG, configuration.size(), 1), configuration);
        EXPECT_EQ(part(HXA_FLASH_PART_BOOTOVL, overlay.size()), bytes_of("43218765"));
        EXPECT_TRUE(left_nothing());
    }
}

TEST_F(Boot_Update, fits_the_option_rom_to_the_card)
{
    ASSERT_EQ(update(archive_of(description), 0x17), HXA_STATUS_OK);
    Bytes rom = Rom{}.build();
    ASSERT_EQ(hxal::update_device_id_chksum(rom, 0x17), HXA_STATUS_OK);
    hxal::reverse_words(rom);
    EXPECT_EQ(part(HXA_FLASH_PART_OPTROM, rom.size()), rom);
    EXPECT_THAT(commands(), testing::Contains("IOCMD_FLASH_ENABLE_OPTROM"));
    ASSERT_EQ(update(archive_of(description), 0x21), HXA_STATUS_OK);
    EXPECT_THAT(commands(), ElementsAre("IOCMD_FLASH_UPDATE_PART", "IOCMD_FLASH_READ_PART")) << "no option ROM switch";
}

TEST_F(Boot_Update, asks_nothing_of_the_card_unless_the_whole_archive_was_read)
{
    const Archive whole = archive_of(description);
    const size_t last_member = whole.bytes.size() - 512;
    for (size_t size = 0; size <= last_member; size += 512)
    {
        const Archive cut{whole.bytes.substr(0, size)};
        EXPECT_EQ(update(cut, 0x13), HXA_STATUS_BAD_FILE) << size;
        EXPECT_EQ(update(wrapped(cut), 0x13), HXA_STATUS_BAD_FILE) << size;
        const Archive cut_wrapper{wrapped(whole).bytes.substr(0, size)};
        EXPECT_EQ(update(cut_wrapper, 0x13), HXA_STATUS_BAD_FILE) << size;
    }
    for (const char* size : {"77777777777", "00000020000", "0000000000x", "-0000000001", "           ", "\x80"})
        for (const size_t member : {0u, 1u})
        {
            Archive lying;
            lying.add("boot.txt", bytes_of(description), member == 0 ? size : "").add("optrom.bin", {1}, member == 1 ? size : "");
            EXPECT_EQ(update(lying, 0x13), HXA_STATUS_BAD_FILE) << size;
        }
    for (const char* path : {"/dev/zero", ".", "pipe"})
    {
        ::mkfifo("pipe", 0600);
        EXPECT_EQ(hxal_boot_fwupdate(hxal_adapter_get_port(1), path, 0x13), HXA_STATUS_BAD_FILE) << path;
    }
    EXPECT_EQ(hxal_boot_fwupdate(hxal_adapter_get_port(1), "missing", 0x13), HXA_STATUS_FAILED);
    EXPECT_EQ(hxal_boot_fwupdate(hxal_adapter_get_port(1), "missing", 0x22), HXA_STATUS_INVALID_DEVID);
    EXPECT_EQ(update(wrapped(wrapped(whole)), 0x13), HXA_STATUS_FAILED) << "one wrapper, not two";
    EXPECT_THAT(commands(), IsEmpty());
    EXPECT_FALSE(fs::exists("zmlrtmpfile"));
}

TEST_F(Boot_Update, unpacks_to_a_file_of_its_own_or_not_at_all)
{
    std::ofstream("victim") << "mine";
    fs::create_symlink("victim", "zmlrtmpfile");
    EXPECT_EQ(update(wrapped(archive_of(description)), 0x13), HXA_STATUS_OK);
    EXPECT_EQ(fs::file_size("victim"), 4u);
    EXPECT_FALSE(fs::exists(fs::symlink_status("zmlrtmpfile")));

    rlimit before{};
    ::getrlimit(RLIMIT_FSIZE, &before);
    const rlimit full{1024, before.rlim_max};
    ::setrlimit(RLIMIT_FSIZE, &full); // a full disk, with a signal that would end the process
    const hxa_status_t no_room = hxal_boot_fwupdate(hxal_adapter_get_port(1), "archive", 0x13);
    ::setrlimit(RLIMIT_FSIZE, &before);
    EXPECT_EQ(no_room, HXA_STATUS_CREATE_FILE);
    EXPECT_FALSE(fs::exists("zmlrtmpfile"));
    fs::create_directory("zmlrtmpfile");
    EXPECT_EQ(update(wrapped(archive_of(description)), 0x13), HXA_STATUS_CREATE_FILE);
    EXPECT_TRUE(fs::is_directory("zmlrtmpfile"));

    const std::string archive = fs::absolute("archive");
    fs::current_path("/proc");
    EXPECT_EQ(hxal_boot_fwupdate(hxal_adapter_get_port(1), archive.c_str(), 0x13), HXA_STATUS_CREATE_FILE) << "unwritable";
}

TEST_F(Boot_Update, keeps_to_the_file_that_it_opened)
{
    const auto save_uniform = [](const char* path, uint8_t byte)
    {
        const Bytes image(4096, byte);
        Archive()
            .add("boot.txt", bytes_of("IMAGE\nTYPE=F\nID=13\nIMAGE\nTYPE=L\nID=13\n"))
            .add("firmware.bin", image)
            .add("overlay.bin", image)
            .save(path);
    };
    save_uniform("archive", 1);
    save_uniform("other", 2);
    std::atomic<bool> over = false;
    std::thread swapper(
        [&]
        {
            while (!over)
                ::renameat2(AT_FDCWD, "archive", AT_FDCWD, "other", RENAME_EXCHANGE);
        });
    for (int round = 0; round < 100; ++round)
    {
        EXPECT_EQ(hxal_boot_fwupdate(hxal_adapter_get_port(1), "archive", 0x13), HXA_STATUS_OK);
        EXPECT_EQ(part(HXA_FLASH_PART_FWIMG, 4096), part(HXA_FLASH_PART_BOOTOVL, 4096));
    }
    over = true;
    swapper.join();
}

TEST_F(Boot_Update, takes_no_more_than_a_card_holds)
{
    const Archive head_of_48_mib = Archive().add("image.bin", {}, "00300000000");
    const auto add_hole = [] { fs::resize_file("archive", fs::file_size("archive") + (48 << 20)); };
    Archive().add("boot.txt", bytes_of(description)).save("archive");
    for (int image = 0; image < 2; ++image)
    {
        std::ofstream("archive", std::ios::binary | std::ios::app) << head_of_48_mib.bytes;
        add_hole();
    }
    EXPECT_EQ(hxal_boot_fwupdate(hxal_adapter_get_port(1), "archive", 0x13), HXA_STATUS_ENOMEM);
    EXPECT_THAT(commands(), IsEmpty());
}

TEST_F(Boot_Update, ends_with_the_first_image_that_fails)
{
    Bytes broken = firmware;
    broken[0] ^= 1;
    EXPECT_EQ(update(archive_of(description, broken), 0x13), HXA_STATUS_CHECKSUM_FAIL);
    EXPECT_THAT(commands(), ElementsAre("IOCMD_FLASH_UPDATE_PART", "IOCMD_FLASH_READ_PART"));

    EXPECT_EQ(update(archive_of(description), 0x14), HXA_STATUS_DEVID_MISSING);
    fail("IOCMD_FLASH_READ_PART", EIO);
    EXPECT_EQ(update(archive_of(description), 0x13), HXA_STATUS_EIO);
    scan(R"({"adapters": [{"kind": "fc-hba", "flash": [{"type": "optrom", "status": "bad"}]}]})");
    EXPECT_EQ(update(archive_of(description), 0x13), HXA_STATUS_FAILED) << "other bytes are read back";
    scan(R"({"adapters": [{"kind": "fc-hba", "flash": [{"type": "optrom", "size": 1023}]}]})");
    EXPECT_EQ(update(archive_of(description), 0x13), HXA_STATUS_FLASH_BAD_LEN);
    scan(R"({"adapters": [{"kind": "fc-hba", "flash": [{"type": "optrom", "status": "not-present"}]}]})");
    EXPECT_EQ(update(archive_of(description), 0x13), HXA_STATUS_EINVAL);
}

TEST_F(Boot_Update, of_every_card_tells_how_it_goes)
{
    scan(R"({"adapters": [{"kind": "fc-hba"}, {"kind": "cna"}]})");
    archive_of(description).save("archive");
    testing::internal::CaptureStdout();
    EXPECT_EQ(hxal_boot_fwupdate(nullptr, "archive", 0), HXA_STATUS_DEVID_MISSING);
    EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_DEVID_MISSING);
    fail("IOCMD_FLASH_UPDATE_PART", EIO, 0);
    EXPECT_EQ(hxal_boot_fwupdate(nullptr, "archive", 0x21), HXA_STATUS_EIO);
    fail("IOCMD_IOC_GET_ATTR", ENXIO);
    EXPECT_EQ(hxal_boot_fwupdate(nullptr, "archive", 0), HXA_STATUS_ENXIO);
    std::fflush(stdout);
    EXPECT_EQ(testing::internal::GetCapturedStdout(), golden("boot_progress.txt"));
}

TEST(BootDescription, is_read_line_by_line_or_refused)
{
    const std::pair<const char*, size_t> texts[] = {
        // the images of those that are well-formed
        {"IMAGE\nTYPE=O\nID=13\n", 1},
        {"IMAGE\nID=13\nTYPE=O", 1},
        {"IMAGE\r\nTYPE = \tO\r\nID = 13 ,14\r\n", 1},
        {"remark\nIMAGE\nPORT=0,1\nTYPE=\nID=ffff\nremark", 1},
        {"IMAGE\nTYPE=O\nID=0x13,0X17\n", 1},
        {"IMAGE\nTYPE=O\nID=1 3\t,\n", 1},
        {"", 0},
        {"TYPE=O\nID=13\n", 0},                     // before any image
        {"IMAGE\nTYPE=O\nID=13\nPORT=0\n", 0},      // after the image was complete
        {"IMAGE\nTYPE=O\nTYPE=O\nID=13\n", 0},      // twice
        {"IMAGE\nPORT=0\nPORT=0\nTYPE=O\nID=1", 0}, // twice
        {"IMAGE\nTYPE=O\n", 0},                     // never complete
        {"IMAGE\nIMAGE\nTYPE=O\nID=13\n", 0},       // never complete
        {"IMAGE\nTYPE\nID=13\n", 0},                // no value
        {"IMAGE\nTYPE=O\nID=\n", 0},                // no id
        {"IMAGE\nTYPE=O\nID=10000\n", 0},           // no device id
        {"IMAGE\nPORT=100\nTYPE=O\nID=13\n", 0},    // no instance
        {"IMAGE\nTYPE=O\nID=13;14\n", 0},           // no list
        {"IMAGE\nTYPE=O\nID=0x\n", 0},              // no digits
    };
    for (const auto& [text, count] : texts)
    {
        std::vector<hxal::HXAL_IMAGE_DATA_T> images;
        EXPECT_EQ(hxal::read_boot_description(text, images), count > 0 ? HXA_STATUS_OK : HXA_STATUS_FAILED) << text;
        EXPECT_TRUE(count == 0 || images.size() == count) << text;
    }
}

} // namespace
