// The address of a port has one byte order, that of the frames it goes into (FC-FS-2, FC-GS-6): domain, area, port.
#include "tests/sim/simulated_host.h"

namespace
{

class Addresses : public Raw_Host
{
protected:
    Open_File hxa{node_on(R"({"adapters": [{"kind": "fc-hba", "ports": [{"address": "0x010203", "pwwn": "1000000000000001",
        "remote_ports": [{"address": "0x0A0B0C", "pwwn": "2100000000000001", "symbolic_name": "disk"}]}]}]})")};
};

// A frame as it goes over the wire, and the name server's request behind it: whose name is that?
struct Frame
{
    std::array<std::uint8_t, 24> header;
    std::array<std::uint8_t, 20> request;
};

Frame asking(std::array<std::uint8_t, 3> from, std::array<std::uint8_t, 3> of)
{
    return {{0x02, 0xFF, 0xFF, 0xFC, 0, from[0], from[1], from[2], 0x20, 0x29, 0, 0, 0, 0, 0, 0, 0, 0, 0xFF, 0xFF, 0, 0, 0, 0},
            {1, 0, 0, 0, 0xFC, 2, 0, 0, 0x01, 0x18, 0, 0, 0, 0, 0, 0, 0, of[0], of[1], of[2]}};
}

TEST_F(Addresses, lie_in_records_as_on_the_wire)
{
    std::uint8_t logical_port[232]{0, 0, 0, 0, 0, 0, 0, 0, 0x10, 0, 0, 0, 0, 0, 0, 0x01};
    ASSERT_EQ(ioctl(*hxa, 0xC0E8B101UL, logical_port), 0);
    EXPECT_EQ(digits_of(std::array{logical_port[20], logical_port[21], logical_port[22], logical_port[23]}), "01020300");
    std::uint8_t remote_port[344]{0, 0, 0, 0, 0, 0, 0, 0, 0x10, 0, 0, 0, 0, 0, 0, 0x01, 0x21, 0, 0, 0, 0, 0, 0, 0x01};
    ASSERT_EQ(ioctl(*hxa, 0xC158B205UL, remote_port), 0);
    EXPECT_EQ(digits_of(std::array{remote_port[44], remote_port[45], remote_port[46], remote_port[47]}), "0A0B0C00");
    EXPECT_EQ(port(hxa, 'C', 0).pid, *reinterpret_cast<std::uint32_t*>(&logical_port[20]));
}

TEST_F(Addresses, go_into_frames_as_they_lie_there)
{
    const struct
    {
        std::array<std::uint8_t, 3> from, of;
        int status;
        const char* answer; // the CT response and, behind its header, the name
    } cases[] = {
        {{1, 2, 3}, {0x0A, 0x0B, 0x0C}, HXA_STATUS_OK, "8002 disk"},
        {{1, 2, 3}, {0x0C, 0x0B, 0x0A}, HXA_STATUS_OK, "8001 "},
        {{3, 2, 1}, {0x0A, 0x0B, 0x0C}, HXA_STATUS_BADFRMHDR, "0000 "},
    };
    for (const auto& [from, of, status, answer] : cases)
    {
        const auto frame = asking(from, of);
        std::array<std::uint8_t, 512> response{};
        hxa_ioctl_fcpt_t record{};
        record.lpwwn = 0x01'00'00'00'00'00'00'10;
        std::memcpy(&record.fchs, frame.header.data(), frame.header.size());
        record.reqsz = frame.request.size();
        record.rspsz = response.size();
        record.reqbuf_ptr = reinterpret_cast<std::uintptr_t>(frame.request.data());
        record.rspbuf_ptr = reinterpret_cast<std::uintptr_t>(response.data());
        ASSERT_EQ(send(*hxa, "IOCMD_FCPT", '\xBA', record), 0);
        EXPECT_EQ(record.status, status);
        EXPECT_EQ(digits_of(std::array{response[8], response[9]}) + " " +
                      std::string(response.begin() + 17, response.begin() + 17 + response[16]),
                  answer);
    }
}

} // namespace
