// Requests that are made to fail, by a test or by the scenario.
#include "tests/sim/simulated_host.h"

#include <array>
#include <chrono>
#include <thread>

namespace
{

class Faults : public Raw_Host
{
protected:
    Faults() : Raw_Host("cna") {}

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
    EXPECT_THAT(outcomes(5), testing::ElementsAre(0, EIO, EIO, 0, 0));
    hxasim::inject({.error = EINTR});
    EXPECT_THAT(outcomes(3), testing::ElementsAre(EINTR, EINTR, EINTR));
    hxasim::clear_faults();
    hxasim::inject({.node = "/dev/hxn", .error = EIO});
    hxasim::inject({.status = 13, .times = 2});
    hxasim::inject({.error = ENXIO, .times = 0});
    EXPECT_THAT(outcomes(4), testing::ElementsAre(-13, -13, 0, 0)) << "in the order of injection";
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
    EXPECT_THAT(order, testing::ElementsAre(0, 1));
}

class Scsi_Faults : public Faults
{
protected:
    struct Answer
    {
        int error;
        hxa_ioctl_scsi_t record;
        std::array<std::uint8_t, 36> data;
    };

    Answer inquire()
    {
        Answer answer{};
        auto& record = answer.record;
        record.lpwwn = 0x01'00'00'00'00'00'00'10;
        record.rpwwn = 0x01'00'00'00'00'00'00'21;
        record.cdb = {{0x12, 0, 0, 0, 36}};
        record.iosz = answer.data.size();
        record.snssz = 18;
        record.iobuf_ptr = reinterpret_cast<std::uintptr_t>(answer.data.data());
        record.snsbuf_pt = reinterpret_cast<std::uintptr_t>(_sense.data());
        answer.error = send(*_hxa, "IOCMD_SCSI_CMND", '\xBA', record);
        return answer;
    }

private:
    Open_File _hxa{node_on(R"({"adapters": [{"kind": "fc-hba", "ports": [{"pwwn": "1000000000000001", "remote_ports": [
        {"pwwn": "2100000000000001"}]}]}]})")};
    std::array<std::uint8_t, 18> _sense{};
};

TEST_F(Scsi_Faults, bring_back_garbage)
{
    hxasim::inject({.error = EIO, .times = 2, .garbage = 7});
    const auto failed = inquire();
    EXPECT_EQ(failed.error, EIO);
    EXPECT_NE(failed.record.status, HXA_STATUS_OK);
    EXPECT_NE(failed.data[0], 0);
    EXPECT_EQ(failed.data, inquire().data) << "the same seed";
    hxasim::inject({.garbage = 8});
    const auto answered = inquire();
    EXPECT_EQ(answered.error, 0);
    EXPECT_EQ(answered.record.status, HXA_STATUS_OK);
    EXPECT_NE(answered.record.snssz, 0U);
    EXPECT_NE(answered.data[0], 0);
}

} // namespace
