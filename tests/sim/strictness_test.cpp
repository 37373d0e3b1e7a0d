// Requests that no driver accepts fail, are told as violations, and are recorded like all others.
#include "tests/sim/simulated_host.h"
#include "tests/support/rows.h"

#include <sys/mman.h>

#include <map>

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

TEST_F(Strictness, refuses_bad_requests_and_leaves_the_record_alone)
{
    const std::map<std::string, int> errors = {{"ENOTTY", ENOTTY}, {"EINVAL", EINVAL}, {"ENODEV", ENODEV}};
    const auto rows = rows_of("bad_requests.txt");
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.at(5));
        std::array<std::uint8_t, 2048> record{};
        record.at(std::stoul(row[2])) = static_cast<std::uint8_t>(std::stoul(row[3]));
        auto sent = record;
        errno = 0;
        EXPECT_EQ(ioctl(row[0] == "/dev/hxa" ? *hxa : *hxn, std::stoul(row[1], nullptr, 16), record.data()), -1);
        EXPECT_EQ(errno, errors.at(row[4]));
        EXPECT_EQ(record, sent);
        expect_violation(row[5]);
    }
    auto requests = hxasim::take_requests();
    ASSERT_EQ(requests.size(), rows.size());
    for (std::size_t i = 0; i < requests.size(); ++i)
    {
        EXPECT_EQ(requests[i].command, std::stoul(rows[i][1], nullptr, 16));
        EXPECT_EQ(requests[i].error, errors.at(rows[i][4]));
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
