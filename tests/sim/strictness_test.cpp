// Requests that no driver accepts fail, are told as violations, and are recorded like all others.
#include "tests/sim/simulated_host.h"

#include <sys/mman.h>

namespace
{

using ::testing::IsEmpty;

class Strictness : public Raw_Host
{
protected:
    Strictness() : Raw_Host("cna") {}

    Open_File hxa{"/dev/hxa"};
    Open_File hxn{"/dev/hxn"};
};

struct Bad_Request
{
    const char* node;
    std::uint32_t code;
    std::size_t offset; // of one byte that is set in a record of zeros
    std::uint8_t value;
    int error;
    const char* violation;
};

// clang-format off
const Bad_Request bad_requests[] = {
    // commands that the node does not know
    {"/dev/hxa", 0xC0084399, 0, 0, ENOTTY, "/dev/hxa 0xC0084399: unknown command"},
    {"/dev/hxa", 0xC648B006, 0, 0, ENOTTY, "/dev/hxa 0xC648B006: unknown command"},
    {"/dev/hxa", 0x86484306, 0, 0, ENOTTY, "/dev/hxa 0x86484306: unknown command"},
    {"/dev/hxa", 0xC6484406, 0, 0, ENOTTY, "/dev/hxa IOCMD_IOC_GET_ATTR: belongs on /dev/hxn"},
    {"/dev/hxn", 0xC058432A, 0, 0, ENOTTY, "/dev/hxn IOCMD_AEN_SYNC: belongs on /dev/hxa"},
    // records of another size
    {"/dev/hxa", 0xC6474306, 0, 0, EINVAL, "/dev/hxa IOCMD_IOC_GET_ATTR: record of 1607 bytes, must be 1608"},
    // bytes that must be 0: status, reserved, output, the last one
    {"/dev/hxa", 0xC6484306,    0,   1, EINVAL, "/dev/hxa IOCMD_IOC_GET_ATTR instance 0: byte 0 is 1, must be 0"},
    {"/dev/hxa", 0xC6484306,    6, 255, EINVAL, "/dev/hxa IOCMD_IOC_GET_ATTR instance 0: byte 6 is 255, must be 0"},
    {"/dev/hxn", 0xC2084407, 519, 7, EINVAL, "/dev/hxn IOCMD_IOC_GET_INFO instance 0: byte 519 is 7, must be 0"},
    {"/dev/hxa", 0xC0084301,    4,   2, EINVAL, "/dev/hxa IOCMD_IOC_GET_VERSION: byte 4 is 2, must be 0"},
    {"/dev/hxa", 0xC058432A,    0,   1, EINVAL, "/dev/hxa IOCMD_AEN_SYNC: byte 0 is 1, must be 0"},
    {"/dev/hxa", 0xC058432A,   16,   1, EINVAL, "/dev/hxa IOCMD_AEN_SYNC: byte 16 is 1, must be 0"},
    {"/dev/hxa", 0xC0584329,   12,   1, EINVAL, "/dev/hxa IOCMD_AEN_GET instance 0: byte 12 is 1, must be 0"},
    {"/dev/hxa", 0xC0584329,   16,   1, EINVAL, "/dev/hxa IOCMD_AEN_GET instance 0: byte 16 is 1, must be 0"},
    {"/dev/hxa", 0xC060BA02,   36,   1, EINVAL, "/dev/hxa IOCMD_FCPT instance 0: byte 36 is 1, must be 0"},
    {"/dev/hxa", 0xC020B207,   12,   1, EINVAL, "/dev/hxa IOCMD_RPORT_SET_SPEED instance 0: byte 12 is 1, must be 0"},
    // inputs that make no sense
    {"/dev/hxa", 0xC018432E,    8,   1, EINVAL, "/dev/hxa IOCMD_PORT_GET_STATS instance 0: buffer of 1 bytes, must be 304"},
    {"/dev/hxa", 0xC060BA02,   64,   1, EINVAL, "/dev/hxa IOCMD_FCPT instance 0: needs a nexus: 1"},
    {"/dev/hxa", 0xC060BA02,   40,   0, EINVAL, "/dev/hxa IOCMD_FCPT instance 0: frame without R_CTL"},
    {"/dev/hxa", 0xC060BA02,   40,   2, EINVAL, "/dev/hxa IOCMD_FCPT instance 0: frame without D_ID"},
    {"/dev/hxa", 0xC0584329,    8,   2, EINVAL,
     "/dev/hxa IOCMD_AEN_GET instance 0: application 2 has not synchronised on this descriptor"},
    {"/dev/hxa", 0xC0584329,    7, 128, EINVAL, "/dev/hxa IOCMD_AEN_GET instance 0: room for -2147483648 events"},
    // instances and applications that are not there
    {"/dev/hxa", 0xC178432D,    4,   2, ENODEV, "/dev/hxa IOCMD_PORT_GET_ATTR instance 2: no such instance"},
    {"/dev/hxn", 0xC178442D,    5,   1, ENODEV, "/dev/hxn IOCMD_PORT_GET_ATTR instance 256: no such instance"},
    {"/dev/hxa", 0xC0584329,    0,   2, ENODEV, "/dev/hxa IOCMD_AEN_GET instance 2: no such instance"},
    {"/dev/hxa", 0xC058432A,    8,   5, EINVAL, "/dev/hxa IOCMD_AEN_SYNC: no such application: 5"},
    {"/dev/hxa", 0xC0584329,    8,   5, EINVAL, "/dev/hxa IOCMD_AEN_GET instance 0: no such application: 5"},
};
// clang-format on

TEST_F(Strictness, refuses_bad_requests_and_leaves_the_record_alone)
{
    for (const auto& bad : bad_requests)
    {
        SCOPED_TRACE(bad.violation);
        std::array<std::uint8_t, 2048> record{};
        record[bad.offset] = bad.value;
        auto sent = record;
        errno = 0;
        EXPECT_EQ(ioctl(std::string(bad.node) == "/dev/hxa" ? *hxa : *hxn, bad.code, record.data()), -1);
        EXPECT_EQ(errno, bad.error);
        EXPECT_EQ(record, sent);
        expect_violation(bad.violation);
    }
    auto requests = hxasim::take_requests();
    ASSERT_EQ(requests.size(), std::size(bad_requests));
    for (std::size_t i = 0; i < requests.size(); ++i)
    {
        EXPECT_EQ(requests[i].command, bad_requests[i].code);
        EXPECT_EQ(requests[i].error, bad_requests[i].error);
        EXPECT_THAT(requests[i].answered, IsEmpty());
    }
    EXPECT_EQ(requests[0].name, "");
    EXPECT_EQ(requests[3].name, "IOCMD_IOC_GET_ATTR");
}

TEST_F(Strictness, opens_a_node_for_reading_and_writing_only)
{
    for (int flags : {O_RDONLY, O_WRONLY})
    {
        EXPECT_EQ(open("/dev/hxn", flags), -1);
        EXPECT_EQ(errno, EACCES);
        expect_violation("/dev/hxn: not opened for reading and writing");
    }
}

TEST_F(Strictness, answers_bad_addresses_without_touching_them)
{
    void* page = mmap(nullptr, 4096, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    ASSERT_NE(page, MAP_FAILED);
    auto code = code_of("IOCMD_IOC_GET_ATTR", 'C');
    for (int protection : {PROT_NONE, PROT_READ})
    {
        ASSERT_EQ(mprotect(page, 4096, protection), 0);
        EXPECT_EQ(ioctl(*hxa, code, page), -1);
        EXPECT_EQ(errno, EFAULT);
    }
    munmap(page, 4096);
    EXPECT_EQ(ioctl(*hxa, code, nullptr), -1);
    EXPECT_EQ(errno, EFAULT);
    hxa_ioctl_port_stats_t record{}; // and inside a record
    record.buf_size = sizeof(hxa_pport_stats_t);
    record.buf_ptr = 16;
    EXPECT_EQ(send(*hxa, "IOCMD_PORT_GET_STATS", 'C', record), EFAULT);
    expect_violation("/dev/hxa IOCMD_IOC_GET_ATTR: bad address");
    expect_violation("/dev/hxa IOCMD_IOC_GET_ATTR instance 0: bad address");
    expect_violation("/dev/hxa IOCMD_IOC_GET_ATTR: bad address");
    expect_violation("/dev/hxa IOCMD_PORT_GET_STATS instance 0: bad address of the counters");
}

} // namespace
