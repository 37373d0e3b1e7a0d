// Remote ports and their nexuses, where more than one request or a conversion is behind an operation, and what the name server
// tells of them.
#include "tests/hxal/library_fixture.h"

#include <array>
#include <cerrno>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;

const std::string two_ports = R"({"adapters": [{"kind": "fc-hba", "ports": [
    {"address": "0x010203",
     "remote_ports": [
       {"pwwn": "2100000000000001", "address": "0x020304", "symbolic_name": "disk array",
        "nexus": {"latency_sum": 600, "latency_count": 4, "clock_resolution": 10, "rec_support": 1}},
       {"pwwn": "2100000000000002", "address": "0x020305", "function": "initiator"}]},
    {"state": "linkdown", "remote_ports": [{"pwwn": "2100000000000001"}]}]}]})";

class Fabric : public Library_Test
{
protected:
    Fabric()
    {
        scan(two_ports);
        ioc = hxal_ioc_open_idx(0);
        base = ioc->pwwn;
    }

    // Asks for the name of the disk array.
    hxa_status_t ask(hxa_rport_symname_t& name, uint32_t pid = 0x040302)
    {
        return hxal_get_rport_symname(ioc, 0, pid, base, disks, &name);
    }

    hxal_t* ioc = nullptr;
    wwn_t base = 0;
    const wwn_t disks = wwn({0x21, 0, 0, 0, 0, 0, 0, 1});
    const wwn_t initiator = wwn({0x21, 0, 0, 0, 0, 0, 0, 2});
    const wwn_t nobody = wwn({0x21, 0, 0, 0, 0, 0, 0, 9});
};

TEST_F(Fabric, lists_remote_ports_up_to_the_room)
{
    wwn_t list[2] = {};
    uint32_t room = 2;
    EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, nullptr, &(room = 0)), HXA_STATUS_OK);
    EXPECT_EQ(room, 0u);
    EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, nullptr, &(room = 1)), HXA_STATUS_EINVAL);
    distort("IOCMD_LPORT_GET_RPORTS", 24, {0xFF, 0xFF, 0xFF, 0xFF});
    EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, list, &(room = 2)), HXA_STATUS_OK);
    EXPECT_THAT(list, ElementsAre(disks, initiator));
    EXPECT_EQ(room, UINT32_MAX) << "as the driver says";
}

TEST_F(Fabric, takes_the_logical_port_0_for_the_base_port)
{
    hxa_rport_attr_t attr{};
    const auto call_each = [&]
    {
        hxa_rport_stats_t stats{};
        return std::array{hxal_rport_get_attr(ioc, 0, 0, disks, &attr), hxal_rport_get_stats(ioc, 0, 0, disks, &stats),
                          hxal_rport_reset_stats(ioc, 0, 0, disks)};
    };
    EXPECT_THAT(call_each(), testing::Each(HXA_STATUS_OK));
    EXPECT_EQ(attr.pid, 0x040302u) << "as on the wire (FC-FS-2): domain, area, port";
    const auto sent = hxasim::take_requests();
    ASSERT_EQ(sent.size(), 6u);
    for (std::size_t i = 0; i < sent.size(); i += 2)
    {
        EXPECT_EQ(sent[i].name, "IOCMD_PORT_GET_ATTR");
        EXPECT_EQ(std::memcmp(&sent[i + 1].sent[8], &base, sizeof base), 0);
    }
    distort("IOCMD_PORT_GET_ATTR", 0, {HXA_STATUS_DEVBUSY, 0, 0, 0});
    EXPECT_THAT(call_each(), testing::Each(HXA_STATUS_DEVBUSY));
    EXPECT_EQ(commands().size(), 3u);
}

TEST_F(Fabric, averages_the_latency_of_a_nexus)
{
    hxa_itnim_attr_t attr{};
    EXPECT_EQ(hxal_itnim_get_attr(ioc, 0, base, disks, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.rec_support, 1);
    EXPECT_EQ(attr.io_latency.avg, 600u * 10 / 4);

    // min, max, count, clock resolution, sum behind 8 bytes of attributes: in 32 bits, whatever the status, not without a count
    constexpr std::size_t latency = offsetof(hxa_ioctl_itnim_attr_t, attr.io_latency);
    hxasim::inject({.command = "IOCMD_ITNIM_GET_ATTR",
                    .answer = {{0, {HXA_STATUS_DEVBUSY, 0, 0, 0}}, {latency + 8, {3, 0, 0, 0, 2, 0, 0, 0, 0x01, 0, 0, 0x80}}}});
    EXPECT_EQ(hxal_itnim_get_attr(ioc, 0, base, disks, &attr), HXA_STATUS_DEVBUSY);
    EXPECT_EQ(attr.io_latency.avg, 2u / 3) << "0x80000001 * 2 wraps";
    hxasim::clear_faults();
    distort("IOCMD_ITNIM_GET_ATTR", latency + 8, {0, 0, 0, 0});
    EXPECT_EQ(hxal_itnim_get_attr(ioc, 0, base, disks, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.io_latency.avg, 600u);
    hxasim::clear_faults();
    fail("IOCMD_ITNIM_GET_ATTR", EINTR);
    attr.state = 42;
    EXPECT_EQ(hxal_itnim_get_attr(ioc, 0, base, disks, &attr), HXA_STATUS_EINTR);
    EXPECT_EQ(attr.state, 42u);
    EXPECT_EQ(hxal_itnim_get_attr(nullptr, 0, base, disks, &attr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_itnim_get_attr(ioc, 0, base, disks, nullptr), HXA_STATUS_EINVAL);
}

TEST_F(Fabric, tells_the_symbolic_name_of_a_remote_port)
{
    hxa_rport_symname_t name{};
    EXPECT_EQ(ask(name), HXA_STATUS_OK);
    EXPECT_STREQ(name.symname, "disk array");

    const auto sent = hxasim::take_requests();
    ASSERT_EQ(sent.size(), 2u);
    EXPECT_EQ(sent[0].name, "IOCMD_LPORT_GET_ATTR");
    EXPECT_EQ(sent[1].name, "IOCMD_FCPT");
    // FC-FS-2: R_CTL, D_ID, CS_CTL, S_ID, TYPE, F_CTL, SEQ_ID, DF_CTL, SEQ_CNT, OX_ID, RX_ID, parameter
    const std::vector<uint8_t> header = {0x02, 0xFF, 0xFF, 0xFC, 0, 0x01, 0x02, 0x03, 0x20, 0x29, 0, 0,
                                         0,    0,    0,    0,    0, 0,    0xFF, 0xFF, 0,    0,    0, 0};
    hxa_ioctl_fcpt_t record;
    std::memcpy(&record, sent[1].sent.data(), sizeof record);
    EXPECT_EQ(std::vector<uint8_t>(&sent[1].sent[40], &sent[1].sent[64]), header);
    EXPECT_TRUE(record.vf_id == 0 && record.lpwwn == base && record.dpwwn == disks);
    EXPECT_TRUE(record.tsecs == 20 && record.cts == 0 && record.cos == FC_CLASS_3);
    EXPECT_TRUE(record.reqsz == 20 && record.rspsz == 512);
}

// The longest name and beyond: the name server's field holds 255 characters, ours 254.
TEST_F(Fabric, cuts_the_symbolic_name_to_its_field)
{
    for (const std::size_t length : {254u, 255u})
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [
              {"pwwn": "2100000000000001", "address": "0x070000", "symbolic_name": ")" +
             std::string(length, 'n') + R"("}]}]}]})");
        ioc = hxal_ioc_open_idx(0);
        base = ioc->pwwn;
        hxa_rport_symname_t name;
        std::memset(&name, 'x', sizeof name);
        EXPECT_EQ(ask(name, 7), HXA_STATUS_OK);
        EXPECT_EQ(std::string(name.symname), std::string(254, 'n')) << length;
    }
}

TEST_F(Fabric, leaves_the_name_alone_when_there_is_none)
{
    hxa_rport_symname_t name{"before"};
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x050302, base, initiator, &name), HXA_STATUS_OK) << "an empty name";
    EXPECT_EQ(ask(name, 0x999999), HXA_STATUS_FABRIC_RJT) << "an address of nobody";
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x040302, base, nobody, &name), HXA_STATUS_UNKNOWN_RWWN);
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x040302, nobody, disks, &name), HXA_STATUS_UNKNOWN_LWWN);
    const hxal_t* down = hxal_ioc_open_idx(1);
    hxasim::take_requests();
    EXPECT_EQ(hxal_get_rport_symname(down, 0, 0x040302, down->pwwn, disks, &name), HXA_STATUS_PORT_OFFLINE);
    EXPECT_THAT(commands(), ElementsAre("IOCMD_LPORT_GET_ATTR"));
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x040302, base, disks, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_get_rport_symname(nullptr, 0, 0x040302, base, disks, &name), HXA_STATUS_EINVAL);
    EXPECT_THAT(commands(), IsEmpty());

    distort("IOCMD_FCPT", offsetof(hxa_ioctl_fcpt_t, rspsz), {0, 0, 0, 0});
    EXPECT_EQ(ask(name), HXA_STATUS_OK) << "no response";
    EXPECT_STREQ(name.symname, "before");
    hxasim::clear_faults();
    distort("IOCMD_FCPT", offsetof(hxa_ioctl_fcpt_t, rspsz), {0xFF, 0xFF, 0xFF, 0xFF});
    EXPECT_EQ(ask(name), HXA_STATUS_OK) << "a length that lies";
    EXPECT_STREQ(name.symname, "disk array");
}

TEST_F(Fabric, passes_no_frame_or_command_without_its_buffers)
{
    const fchs_t header{};
    uint8_t response[16] = {};
    uint32_t size = 1;
    const auto pass = [&](const fchs_t* frame, uint32_t requested, void* to)
    { return hxal_fcpt(ioc, 0, base, 0, 1, HXA_FALSE, FC_CLASS_3, frame, nullptr, requested, to, &size); };
    EXPECT_EQ(pass(nullptr, 0, response), HXA_STATUS_EINVAL);
    EXPECT_EQ(pass(&header, 1, response), HXA_STATUS_EINVAL);
    EXPECT_EQ(pass(&header, 0, nullptr), HXA_STATUS_EINVAL);
    scsi_cdb_t cdb{};
    const auto send = [&](scsi_cdb_t* command, void* to)
    { return hxal_scsi_inquiry(ioc, 0, base, disks, 0, command, 0, to, sizeof response, nullptr, nullptr, &size); };
    EXPECT_EQ(send(nullptr, response), HXA_STATUS_EINVAL);
    EXPECT_EQ(send(&cdb, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(send(&cdb, response), HXA_STATUS_EINVAL) << "room for sense data, but no buffer";
    EXPECT_THAT(commands(), IsEmpty());
    EXPECT_EQ(hxal_scsi_testunitready(ioc, 0, base, disks, 0, &cdb, 0, nullptr, 0, nullptr, nullptr, nullptr), HXA_STATUS_OK);
}

} // namespace
