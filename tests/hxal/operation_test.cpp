// Every operation of the tables against the simulator's record of requests.
#include "config_model.h"
#include "operation_table.h"
#include "tests/hxal/library_fixture.h"

#include <algorithm>
#include <cerrno>
#include <cstddef>

namespace
{

// The caller's buffer, with a byte in it that no answer leaves there by chance.
struct Buffer
{
    static constexpr std::uint8_t untouched = 0xEE;

    Buffer() { std::memset(bytes, untouched, sizeof bytes); }

    alignas(std::max_align_t) std::uint8_t bytes[4096];
};

// The whole buffer as it has to be when the parts of the record were copied out.
Buffer expected_buffer(const Operation& operation, const std::vector<std::uint8_t>& record)
{
    Buffer expected;
    for (const Copied& part : operation.copied)
        std::memcpy(expected.bytes + part.at, &record.at(part.offset + part.size - 1) - (part.size - 1), part.size);
    return expected;
}

std::vector<std::uint8_t> expected_record(const Operation& operation, int instance)
{
    std::vector<std::uint8_t> record(operation.size);
    record[offsetof(hxa_ioctl_gen_t, hxad_num)] = static_cast<std::uint8_t>(instance);
    for (const Sent& sent : operation.sent)
        std::copy(sent.bytes.begin(), sent.bytes.end(), record.begin() + static_cast<std::ptrdiff_t>(sent.offset));
    return record;
}

class Operations : public Library_Test
{
protected:
    static constexpr int instance = 1;

    // Every byte behind the status differs from its neighbours, and from what was sent.
    static void answer_with_status(hxa_status_t status, const Operation& operation)
    {
        std::vector<std::uint8_t> answer = bytes_of(status);
        for (std::size_t at = answer.size(); at < operation.size; ++at)
            answer.push_back(static_cast<std::uint8_t>(at * 37 + 11));
        hxasim::clear_faults();
        hxasim::inject({.answer = {{0, std::move(answer)}}});
    }

    // Calls the operation, which has to send its record and nothing else; what was answered comes back.
    static std::vector<std::uint8_t> call(const Operation& operation, hxal_t* ioc, hxa_status_t expected, Buffer& buffer)
    {
        EXPECT_EQ(operation.call(ioc, buffer.bytes), expected);
        const auto requests = hxasim::take_requests();
        if (requests.size() != 1)
        {
            ADD_FAILURE() << requests.size() << " requests";
            return std::vector<std::uint8_t>(operation.size);
        }
        const bool ethernet = ioc->ioc_type == HXA_IOC_TYPE_LL;
        const std::uint32_t group = ethernet ? operation.groups.ll : operation.groups.fc;
        EXPECT_EQ(requests[0].node, ethernet ? "/dev/hxn" : "/dev/hxa");
        EXPECT_EQ(requests[0].command, 0xC0000000 | operation.size << 16 | group << 8 | operation.number);
        EXPECT_EQ(requests[0].sent, expected_record(operation, instance));
        return requests[0].answered;
    }

    static void expect_answer_passed_on(const Operation& operation, hxal_t* ioc, hxa_status_t status)
    {
        answer_with_status(status, operation);
        Buffer buffer;
        const auto answered = call(operation, ioc, status, buffer);
        EXPECT_EQ(std::memcmp(buffer.bytes, expected_buffer(operation, answered).bytes, sizeof buffer.bytes), 0)
            << "copied out with status " << status;
    }

    static void expect_error_passed_on(const Operation& operation, hxal_t* ioc)
    {
        hxasim::clear_faults();
        hxasim::inject({.error = EINTR}); // which tempts to try again
        Buffer buffer;
        testing::internal::CaptureStdout();
        call(operation, ioc, HXA_STATUS_EINTR, buffer);
        EXPECT_EQ(testing::internal::GetCapturedStdout(), operation.printed_on_error);
        const Buffer expected =
            operation.is_in_place ? expected_buffer(operation, expected_record(operation, instance)) : Buffer();
        EXPECT_EQ(std::memcmp(buffer.bytes, expected.bytes, sizeof buffer.bytes), 0) << "after an error";
    }

    static void expect_nothing_sent(const Operation& operation, hxal_t* ioc, void* output, hxa_status_t status)
    {
        EXPECT_EQ(operation.call(ioc, output), status);
        EXPECT_THAT(commands(), testing::IsEmpty());
    }

    static void expect_refused(const Operation& operation, hxal_t* ioc)
    {
        Buffer buffer;
        testing::internal::CaptureStdout();
        expect_nothing_sent(operation, ioc, buffer.bytes, HXA_STATUS_FAILED);
        EXPECT_EQ(testing::internal::GetCapturedStdout(), operation.printed_on_refusal);
        EXPECT_EQ(std::memcmp(buffer.bytes, Buffer().bytes, sizeof buffer.bytes), 0);
    }

    // The settings that came since.
    static Lines added(const std::vector<std::string>& before)
    {
        Lines lines = settings();
        std::erase_if(lines, [&](const std::string& line) { return std::ranges::count(before, line) > 0; });
        return lines;
    }

    static void check(const Operation& operation, hxal_t* ioc)
    {
        if (ioc->ioc_type == HXA_IOC_TYPE_LL && operation.groups.ll == 0)
            return expect_refused(operation, ioc);
        const auto before = settings();
        expect_error_passed_on(operation, ioc);
        expect_answer_passed_on(operation, ioc, HXA_STATUS_IOC_NON_OP);
        expect_answer_passed_on(operation, ioc, static_cast<hxa_status_t>(-559038737)); // 0xDEADBEEF
        EXPECT_EQ(settings(), before) << "recorded although refused";
        expect_answer_passed_on(operation, ioc, HXA_STATUS_OK);
        EXPECT_EQ(added(before), ioc->ioc_type == HXA_IOC_TYPE_LL ? operation.ll_recorded : operation.fc_recorded);
        if (!operation.copied.empty())
            check_without_buffer(operation, ioc);
    }

    static void check_without_buffer(const Operation& operation, hxal_t* ioc)
    {
        if (!operation.output_is_optional)
            return expect_nothing_sent(operation, ioc, nullptr, HXA_STATUS_EINVAL);
        answer_with_status(HXA_STATUS_FAILED, operation);
        EXPECT_EQ(operation.call(ioc, nullptr), HXA_STATUS_FAILED);
        EXPECT_THAT(commands(), testing::SizeIs(1));
    }
};

TEST_F(Operations, send_one_record_each_and_hand_on_its_answer)
{
    for (const Operation& operation : operations())
        for (const int idx : {1, 3})
        {
            host(one_cna);
            empty_model();
            ASSERT_EQ(hxal_ioc_scan(), 4);
            hxasim::take_requests();
            hxal_t* ioc = hxal_ioc_open_idx(idx);
            ASSERT_EQ(ioc->instance, instance);
            SCOPED_TRACE("row " + std::to_string(&operation - operations().data()) + " on " + ioc->devpath);
            check(operation, ioc);
            Buffer buffer;
            expect_nothing_sent(operation, nullptr, buffer.bytes, HXA_STATUS_EINVAL);
        }
    EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_OK) << "requests leave it alone";
}

TEST(Status, of_an_errno_is_its_own_or_a_general_failure)
{
    const std::pair<int, hxa_status_t> cases[] = {
        {EINTR, HXA_STATUS_EINTR},   {EIO, HXA_STATUS_EIO},       {ENXIO, HXA_STATUS_ENXIO},
        {EBADF, HXA_STATUS_EBADF},   {ENODEV, HXA_STATUS_NODEV},  {EINVAL, HXA_STATUS_EINVAL},
        {ENOTTY, HXA_STATUS_ENOTTY}, {EAGAIN, HXA_STATUS_FAILED}, {0, HXA_STATUS_FAILED},
    };
    for (const auto& [error, status] : cases)
        EXPECT_EQ(hxal_get_status(error), status) << error;
}

} // namespace
