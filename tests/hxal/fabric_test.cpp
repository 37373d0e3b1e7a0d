// Logical ports, remote ports and their nexuses on a simulated fabric, and what the name server tells of them.
#include "simulated_host.h"

#include <cerrno>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;

const std::string two_ports = R"({"adapters": [{"kind": "fc-hba", "ports": [
    {"address": "0x010203", "fabric_name": "100000051EF00001",
     "counters": {"logical_port": [7]},
     "remote_ports": [
       {"pwwn": "2100000000000001", "address": "0x020304", "symbolic_name": "disk array",
        "bus": 1, "target": 9, "counters": [1, 2, 3],
        "nexus": {"latency_sum": 600, "latency_count": 4, "clock_resolution": 10, "rec_support": 1, "counters": [5]}},
       {"pwwn": "2100000000000002", "address": "0x020305", "function": "initiator", "speed": 4},
       {"pwwn": "2100000000000003", "address": "0x020306", "state": "logo"}],
     "virtual_ports": [
       {"pwwn": "2001000000000001", "virtual_fabric": 5, "symbolic_name": "guest", "address": "0x010204"}]},
    {"state": "linkdown", "remote_ports": [{"pwwn": "2100000000000001"}]}]}]})";

class Fabric : public Simulated_Host
{
protected:
    Fabric()
    {
        scan(two_ports);
        ioc = hxal_ioc_open_idx(0);
        base = ioc->pwwn;
    }

    hxa_rport_attr_t remote_port(wwn_t rpwwn)
    {
        hxa_rport_attr_t attr{};
        EXPECT_EQ(hxal_rport_get_attr(ioc, 0, base, rpwwn, &attr), HXA_STATUS_OK);
        return attr;
    }

    std::vector<wwn_t> remote_ports(std::uint32_t room = 8)
    {
        std::vector<wwn_t> list(room);
        EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, list.data(), &room), HXA_STATUS_OK);
        list.resize(room);
        return list;
    }

    // Asks for the name of the disk array.
    hxa_status_t ask(hxa_rport_symname_t& name, uint32_t pid = 0x020304)
    {
        return hxal_get_rport_symname(ioc, 0, pid, base, disks, &name);
    }

    hxal_t* ioc = nullptr;
    wwn_t base = 0;
    const wwn_t disks = wwn({0x21, 0, 0, 0, 0, 0, 0, 1});
    const wwn_t initiator = wwn({0x21, 0, 0, 0, 0, 0, 0, 2});
    const wwn_t leaving = wwn({0x21, 0, 0, 0, 0, 0, 0, 3});
    const wwn_t guest = wwn({0x20, 1, 0, 0, 0, 0, 0, 1});
    const wwn_t nobody = wwn({0x21, 0, 0, 0, 0, 0, 0, 9});
};

TEST_F(Fabric, shows_its_logical_ports)
{
    hxa_port_attr_t attr{};
    EXPECT_EQ(hxal_lport_get_attr(ioc, 0, base, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.state, uint32_t{HXA_PORT_ONLINE});
    EXPECT_EQ(attr.pid, 0x010203u);
    EXPECT_EQ(attr.fabric_name, wwn({0x10, 0, 0, 0x05, 0x1E, 0xF0, 0, 1}));
    EXPECT_EQ(hxal_lport_get_attr(ioc, 5, guest, &attr), HXA_STATUS_OK);
    EXPECT_STREQ(attr.port_cfg.sym_name, "guest");
    EXPECT_EQ(hxal_lport_get_attr(ioc, 0, guest, &attr), HXA_STATUS_UNKNOWN_VFID);
    EXPECT_EQ(hxal_lport_get_attr(ioc, 0, nobody, &attr), HXA_STATUS_UNKNOWN_LWWN);
    const hxal_t* down = hxal_ioc_open_idx(1);
    EXPECT_EQ(hxal_lport_get_attr(down, 0, down->pwwn, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.state, uint32_t{HXA_PORT_OFFLINE});
    EXPECT_EQ(attr.pid, 0u);
}

TEST_F(Fabric, lists_remote_ports_up_to_the_room)
{
    EXPECT_THAT(remote_ports(), ElementsAre(disks, initiator, leaving));
    EXPECT_THAT(remote_ports(2), ElementsAre(disks, initiator));
    uint32_t room = 0;
    EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, nullptr, &room), HXA_STATUS_OK);
    EXPECT_EQ(room, 0u);
    room = 1;
    EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, nullptr, &room), HXA_STATUS_EINVAL);
    const hxal_t* down = hxal_ioc_open_idx(1);
    EXPECT_EQ(hxal_lport_get_rports(down, 0, down->pwwn, nullptr, &(room = 0)), HXA_STATUS_OK);
    distort("IOCMD_LPORT_GET_RPORTS", 24, {0xFF, 0xFF, 0xFF, 0xFF});
    std::vector<wwn_t> list(2);
    EXPECT_EQ(hxal_lport_get_rports(ioc, 0, base, list.data(), &(room = 2)), HXA_STATUS_OK);
    EXPECT_EQ(room, UINT32_MAX) << "as the driver says";
}

TEST_F(Fabric, shows_remote_ports_until_they_are_removed)
{
    const hxa_rport_attr_t attr = remote_port(disks);
    EXPECT_EQ(attr.state, uint32_t{HXA_RPORT_ONLINE});
    EXPECT_STREQ(attr.symname, "disk array");
    EXPECT_EQ(remote_port(leaving).state, uint32_t{HXA_RPORT_LOGO});

    EXPECT_EQ(hxal_rport_remove(ioc, 0, base, disks), HXA_STATUS_OK);
    hxa_rport_attr_t gone{};
    EXPECT_EQ(hxal_rport_get_attr(ioc, 0, base, disks, &gone), HXA_STATUS_UNKNOWN_RWWN);
    EXPECT_THAT(remote_ports(), ElementsAre(initiator, leaving));
    EXPECT_EQ(hxal_rport_add(ioc, 0, base, disks), HXA_STATUS_OK);
    EXPECT_EQ(remote_port(disks).state, uint32_t{HXA_RPORT_ONLINE});
    hxa_rport_stats_t stats{};
    EXPECT_EQ(hxal_rport_get_stats(ioc, 0, base, disks, &stats), HXA_STATUS_OK);
    EXPECT_EQ(stats.offlines, 1u + 1);
    EXPECT_EQ(stats.onlines, 2u + 1);
    EXPECT_EQ(hxal_rport_add(ioc, 0, base, nobody), HXA_STATUS_OK);
    EXPECT_EQ(remote_port(nobody).state, uint32_t{HXA_RPORT_OFFLINE}) << "nobody there";
}

TEST_F(Fabric, takes_the_logical_port_0_for_the_base_port)
{
    hxa_rport_attr_t attr{};
    hxa_rport_stats_t stats{};
    EXPECT_EQ(hxal_rport_get_attr(ioc, 0, 0, disks, &attr), HXA_STATUS_OK);
    EXPECT_EQ(hxal_rport_get_stats(ioc, 0, 0, disks, &stats), HXA_STATUS_OK);
    EXPECT_EQ(stats.onlines, 2u);
    EXPECT_EQ(hxal_rport_reset_stats(ioc, 0, 0, disks), HXA_STATUS_OK);
    const auto sent = hxasim::take_requests();
    ASSERT_EQ(sent.size(), 6u);
    for (std::size_t i = 0; i < sent.size(); i += 2)
    {
        EXPECT_EQ(sent[i].name, "IOCMD_PORT_GET_ATTR");
        EXPECT_EQ(std::memcmp(&sent[i + 1].sent[8], &base, sizeof base), 0);
    }
    EXPECT_EQ(hxal_rport_get_stats(ioc, 0, base, disks, &stats), HXA_STATUS_OK);
    EXPECT_EQ(stats.onlines, 0u) << "reset";

    hxasim::take_requests();
    distort("IOCMD_PORT_GET_ATTR", 0, {HXA_STATUS_DEVBUSY, 0, 0, 0});
    EXPECT_EQ(hxal_rport_get_attr(ioc, 0, 0, disks, &attr), HXA_STATUS_DEVBUSY);
    EXPECT_EQ(hxal_rport_get_stats(ioc, 0, 0, disks, &stats), HXA_STATUS_DEVBUSY);
    EXPECT_EQ(hxal_rport_reset_stats(ioc, 0, 0, disks), HXA_STATUS_DEVBUSY);
    EXPECT_EQ(requests().size(), 3u);
}

TEST_F(Fabric, tells_where_a_target_is_and_takes_its_speed)
{
    uint32_t host = 9, bus = 9, target = 0;
    EXPECT_EQ(hxal_rport_get_scsi_address(ioc, 0, base, disks, &host, &bus, &target), HXA_STATUS_OK);
    EXPECT_THAT((std::vector{host, bus, target}), ElementsAre(0u, 1u, 9u));
    EXPECT_EQ(hxal_rport_get_scsi_address(ioc, 0, base, initiator, &host, &bus, &target), HXA_STATUS_NO_FCPIM_NEXUS);

    EXPECT_EQ(hxal_rport_set_speed(ioc, 0, base, disks, HXA_PPORT_SPEED_2GBPS), HXA_STATUS_OK);
    for (const int no_speed : {3, 9, 15})
        EXPECT_EQ(hxal_rport_set_speed(ioc, 0, base, disks, static_cast<hxa_pport_speed_t>(no_speed)), HXA_STATUS_UNSUPP_SPEED);
    EXPECT_EQ(remote_port(disks).assigned_speed, 2u);
    EXPECT_EQ(hxal_rport_set_speed(ioc, 0, base, initiator, HXA_PPORT_SPEED_2GBPS), HXA_STATUS_RPSC_ENABLED);
}

TEST_F(Fabric, averages_the_latency_of_a_nexus)
{
    hxa_itnim_attr_t attr{};
    EXPECT_EQ(hxal_itnim_get_attr(ioc, 0, base, disks, &attr), HXA_STATUS_OK);
    EXPECT_THAT(requests(), ElementsAre("IOCMD_ITNIM_GET_ATTR"));
    EXPECT_EQ(attr.state, uint32_t{HXA_ITNIM_ONLINE});
    EXPECT_EQ(attr.rec_support, 1);
    EXPECT_EQ(attr.io_latency.count, 4u);
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

TEST_F(Fabric, counts_logins_when_the_port_goes_and_comes_back)
{
    EXPECT_EQ(hxal_port_disable(ioc), HXA_STATUS_OK);
    EXPECT_THAT(remote_ports(), IsEmpty());
    EXPECT_EQ(remote_port(disks).state, uint32_t{HXA_RPORT_OFFLINE});
    EXPECT_EQ(hxal_port_enable(ioc), HXA_STATUS_OK);
    hxa_itnim_stats_t nexus{};
    EXPECT_EQ(hxal_itnim_get_stats(ioc, 0, base, disks, &nexus), HXA_STATUS_OK);
    EXPECT_EQ(nexus.onlines, 6u);
    EXPECT_EQ(nexus.offlines, 1u);
    EXPECT_EQ(hxal_itnim_get_stats(ioc, 0, base, initiator, &nexus), HXA_STATUS_NO_FCPIM_NEXUS);
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
    const std::vector<uint8_t> header = {0x02, 0xFF, 0xFF, 0xFC, 0, 0x03, 0x02, 0x01, 0x20, 0x29, 0, 0,
                                         0,    0,    0,    0,    0, 0,    0xFF, 0xFF, 0,    0,    0, 0};
    hxa_ioctl_fcpt_t record;
    std::memcpy(&record, sent[1].sent.data(), sizeof record);
    EXPECT_EQ(std::vector<uint8_t>(&sent[1].sent[40], &sent[1].sent[64]), header);
    EXPECT_EQ(record.vf_id, 0);
    EXPECT_EQ(record.lpwwn, base);
    EXPECT_EQ(record.dpwwn, disks);
    EXPECT_EQ(record.tsecs, 20u);
    EXPECT_EQ(record.cts, 0);
    EXPECT_EQ(record.cos, uint32_t{FC_CLASS_3});
    EXPECT_EQ(record.reqsz, 20u);
    EXPECT_EQ(record.rspsz, 512u);
}

// The longest name and beyond: the name server's field holds 255 characters, ours 254.
TEST_F(Fabric, cuts_the_symbolic_name_to_its_field)
{
    for (const std::size_t length : {254u, 255u})
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [
              {"pwwn": "2100000000000001", "address": 7, "symbolic_name": ")" +
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
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x020305, base, initiator, &name), HXA_STATUS_OK) << "an empty name";
    EXPECT_EQ(ask(name, 0x999999), HXA_STATUS_FABRIC_RJT) << "an address of nobody";
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x020304, base, nobody, &name), HXA_STATUS_UNKNOWN_RWWN);
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x020304, nobody, disks, &name), HXA_STATUS_UNKNOWN_LWWN);
    const hxal_t* down = hxal_ioc_open_idx(1);
    hxasim::take_requests();
    EXPECT_EQ(hxal_get_rport_symname(down, 0, 0x020304, down->pwwn, disks, &name), HXA_STATUS_PORT_OFFLINE);
    EXPECT_THAT(requests(), ElementsAre("IOCMD_LPORT_GET_ATTR"));
    EXPECT_EQ(hxal_get_rport_symname(ioc, 0, 0x020304, base, disks, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_get_rport_symname(nullptr, 0, 0x020304, base, disks, &name), HXA_STATUS_EINVAL);
    EXPECT_THAT(requests(), IsEmpty());

    distort("IOCMD_FCPT", offsetof(hxa_ioctl_fcpt_t, rspsz), {0, 0, 0, 0});
    EXPECT_EQ(ask(name), HXA_STATUS_OK) << "no response";
    EXPECT_STREQ(name.symname, "before");
    hxasim::clear_faults();
    distort("IOCMD_FCPT", offsetof(hxa_ioctl_fcpt_t, rspsz), {0xFF, 0xFF, 0xFF, 0xFF});
    EXPECT_EQ(ask(name), HXA_STATUS_OK) << "a length that lies";
    EXPECT_STREQ(name.symname, "disk array");
}

TEST_F(Fabric, passes_no_frame_without_header_or_buffers)
{
    const fchs_t header{};
    uint8_t response[16] = {};
    uint32_t size = 1;
    const auto pass = [&](const fchs_t* frame, uint32_t requested, void* to)
    { return hxal_fcpt(ioc, 0, base, 0, 1, HXA_FALSE, FC_CLASS_3, frame, nullptr, requested, to, &size); };
    EXPECT_EQ(pass(nullptr, 0, response), HXA_STATUS_EINVAL);
    EXPECT_EQ(pass(&header, 1, response), HXA_STATUS_EINVAL);
    EXPECT_EQ(pass(&header, 0, nullptr), HXA_STATUS_EINVAL);
    EXPECT_THAT(requests(), IsEmpty());
}

} // namespace
