// Requests that are made to fail, by a test or by the scenario.
#include "tests/sim/simulated_host.h"

#include <chrono>
#include <thread>

namespace
{

using hxasim::Fault;
using ::testing::ElementsAre;

class Faults : public Simulated_Host
{
protected:
    Faults() : Simulated_Host("cna") {}

    // The errno, or the status as a negative number, of one request for the port attributes.
    static int outcome(std::uint16_t instance)
    {
        Open_File node("/dev/hxa");
        hxa_ioctl_port_attr_t record{};
        record.hxad_num = instance;
        int error = send(*node, "IOCMD_PORT_GET_ATTR", 'C', record);
        return error != 0 ? error : -record.status;
    }

    static std::vector<int> outcomes(int count)
    {
        std::vector<int> results;
        while (count-- > 0)
            results.push_back(outcome(0));
        return results;
    }
};

TEST_F(Faults, strike_after_the_skipped_requests_and_so_many_times)
{
    hxasim::inject({.command = "IOCMD_PORT_GET_ATTR", .error = EIO, .skip = 1, .times = 2});
    EXPECT_THAT(outcomes(5), ElementsAre(0, EIO, EIO, 0, 0));
    hxasim::inject({.error = EINTR});
    EXPECT_THAT(outcomes(3), ElementsAre(EINTR, EINTR, EINTR));
    hxasim::clear_faults();
    hxasim::inject({.node = "/dev/hxn", .error = EIO});
    hxasim::inject({.status = 13, .times = 2});
    hxasim::inject({.error = ENXIO, .times = 0});
    EXPECT_THAT(outcomes(4), ElementsAre(-13, -13, 0, 0)) << "in the order of injection";
}

TEST_F(Faults, put_a_status_where_the_record_keeps_it)
{
    hxasim::inject({.status = 70}); // instance requests carry no status: they go on
    Open_File hxa("/dev/hxa");
    EXPECT_EQ(instances(hxa, 'C').first, 2U);
    hxa_ioctl_aen_t record{};
    EXPECT_EQ(send(*hxa, "IOCMD_AEN_SYNC", 'C', record), 0);
    EXPECT_EQ(record.status, HXA_STATUS_VERSION_FAIL);
    EXPECT_EQ(record.hxad_num, 0);
}

TEST_F(Faults, overwrite_bytes_of_the_answer)
{
    hxasim::load_text(R"({
        "adapters": [{"kind": "cna"}],
        "faults": [
            {"command": "IOCMD_IOC_GET_INST", "node": "/dev/hxn", "answer": {"offset": 0, "bytes": "81000000"}},
            {"command": "IOCMD_IOC_GET_INFO", "status": 1, "times": 1,
             "answer": [{"offset": 8, "bytes": "58595A"}, {"offset": "0x207", "bytes": "ff"}]}
        ]})");
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 2U);
    EXPECT_EQ(instances(Open_File("/dev/hxn"), 'D').first, 129U);
    auto patched = info(Open_File("/dev/hxa"), 'C', 0);
    EXPECT_EQ(patched.status, HXA_STATUS_FAILED);
    EXPECT_EQ(text_of(patched.serialnum), "XYZ");
    EXPECT_EQ(patched.rsvd1[2], 0xFF00);
    EXPECT_EQ(hxasim::take_requests().back().answered[0x207], 0xFF);
}

TEST_F(Faults, delay_an_answer_without_holding_up_others)
{
    using std::chrono::milliseconds;
    using std::chrono::steady_clock;
    hxasim::inject({.command = "IOCMD_PORT_GET_ATTR", .instance = 1, .error = EIO, .delay = 400});
    const auto before = steady_clock::now();
    std::thread slow([] { EXPECT_EQ(outcome(1), EIO); });
    while (hxasim::open_descriptors() == 0)
        std::this_thread::yield();
    std::this_thread::sleep_for(milliseconds(20));
    EXPECT_EQ(outcome(0), 0);
    slow.join();
    EXPECT_GE(steady_clock::now() - before, milliseconds(400));
    std::vector<int> order;
    for (const auto& request : hxasim::take_requests())
        order.push_back(request.instance);
    EXPECT_THAT(order, ElementsAre(0, 1));
}

TEST_F(Faults, that_could_not_do_what_they_say_are_refused)
{
    const std::pair<Fault, const char*> cases[] = {
        {{.command = "IOCMD_IOC_GET_ATTRS", .error = EIO}, "fault.command: no such command: IOCMD_IOC_GET_ATTRS"},
        {{.node = "/dev/hxx", .error = EIO}, "fault.node: no such node: /dev/hxx"},
        {{.command = "IOCMD_IOC_GET_INFO"}, "fault: needs an error, a status, an answer or a delay"},
        {{.command = "IOCMD_IOC_GET_INST", .status = 1}, "fault.status: IOCMD_IOC_GET_INST carries no status"},
        {{.command = "IOCMD_IOC_GET_INST", .answer = {{.offset = 37, .bytes = {1, 2, 3, 4}}}},
         "fault.answer: beyond the 40 bytes of IOCMD_IOC_GET_INST"},
        {{.command = "IOCMD_IOC_GET_INST", .answer = {{.offset = SIZE_MAX, .bytes = {1, 2}}}},
         "fault.answer: beyond the 40 bytes of IOCMD_IOC_GET_INST"},
    };
    for (const auto& row : cases)
        EXPECT_EQ(refusal_of([&] { hxasim::inject(row.first); }), row.second);
}

} // namespace
