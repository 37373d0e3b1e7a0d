// The physical port: what the drivers make of its settings, and its two functions together.
#include "simulated_host.h"

#include <cerrno>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;

class Port : public Simulated_Host
{
protected:
    // An HBA with the instances 0 and 1.
    Port() { scan(R"({"adapters": [{"kind": "fc-hba"}]})"); }

    void scan(const std::string& json)
    {
        ASSERT_GT(Simulated_Host::scan(json), 0);
        ioc = hxal_ioc_open_idx(0);
    }

    hxa_pport_attr_t attributes()
    {
        hxa_pport_attr_t attr{};
        EXPECT_EQ(hxal_port_get_attr(ioc, &attr), HXA_STATUS_OK);
        return attr;
    }

    hxal_t* ioc = nullptr;
};

TEST_F(Port, runs_with_what_it_was_configured_to_from_the_next_start_on)
{
    EXPECT_EQ(hxal_port_cfg_topology(ioc, HXA_PPORT_TOPOLOGY_LOOP), HXA_STATUS_OK);
    EXPECT_EQ(hxal_port_cfg_speed(ioc, HXA_PPORT_SPEED_2GBPS), HXA_STATUS_OK);
    EXPECT_EQ(hxal_port_cfg_maxfrsize(ioc, 512), HXA_STATUS_OK);
    EXPECT_EQ(hxal_port_trunk_enable(ioc, 3), HXA_STATUS_OK);
    EXPECT_EQ(attributes().pport_cfg.speed, HXA_PPORT_SPEED_2GBPS);
    EXPECT_EQ(attributes().pport_cfg.maxfrsize, 512);
    EXPECT_EQ(attributes().pport_cfg.trunk_ports, 3);
    EXPECT_EQ(attributes().speed, 8u) << "the link runs on";

    EXPECT_EQ(hxal_port_disable(ioc), HXA_STATUS_OK);
    EXPECT_EQ(attributes().port_state, uint32_t{HXA_PPORT_ST_DISABLED});
    EXPECT_EQ(attributes().pid, 0u);
    EXPECT_EQ(hxal_port_enable(ioc), HXA_STATUS_OK);
    EXPECT_EQ(hxal_port_trunk_disable(ioc), HXA_STATUS_OK);
    EXPECT_EQ(attributes().port_state, uint32_t{HXA_PPORT_ST_LINKUP});
    EXPECT_EQ(attributes().speed, 2u);
    EXPECT_EQ(attributes().topology, uint32_t{HXA_PPORT_TOPOLOGY_LOOP});
    EXPECT_EQ(attributes().pport_cfg.trunked, 0);
}

TEST_F(Port, is_refused_what_it_cannot_do)
{
    EXPECT_EQ(hxal_port_cfg_topology(ioc, HXA_PPORT_TOPOLOGY_NONE), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_port_cfg_speed(ioc, HXA_PPORT_SPEED_10GBPS), HXA_STATUS_UNSUPP_SPEED);
    for (const uint16_t size : std::initializer_list<uint16_t>{0, 252, 254, 2114, 2116, 65535})
        EXPECT_EQ(hxal_port_cfg_maxfrsize(ioc, size), HXA_STATUS_INVLD_DFSZ) << size;
    for (const uint32_t ports : {0u, 4u, 256u})
        EXPECT_EQ(hxal_port_trunk_enable(ioc, ports), HXA_STATUS_EINVAL) << ports;
    scan(one_cna);
    ioc = hxal_ioc_open_idx(2);
    EXPECT_EQ(hxal_port_cfg_topology(ioc, HXA_PPORT_TOPOLOGY_P2P), HXA_STATUS_CMD_NOTSUPP) << "the Ethernet side";

    scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{"state": "preboot-disabled"}, {"ioc_state": "disabled"}]}]})");
    EXPECT_EQ(hxal_port_enable(ioc), HXA_STATUS_PBC);
    EXPECT_EQ(hxal_port_disable(ioc), HXA_STATUS_PBC);
    EXPECT_EQ(hxal_port_enable(hxal_ioc_open_idx(1)), HXA_STATUS_IOC_NON_OP);
}

// A CNA with an HBA before it, so that instances and list indexes differ: FCoE 1 and 2, Ethernet 0 and 1.
class Port_Pair : public Port
{
protected:
    Port_Pair()
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}, {"kind": "cna"}]})");
        fcoe = hxal_ioc_open_idx(2);
        ethernet = hxal_ioc_open_idx(4);
        EXPECT_EQ(ethernet->port_num, fcoe->port_num);
    }

    static std::vector<std::string> sent()
    {
        std::vector<std::string> sent;
        for (const auto& request : hxasim::take_requests())
            sent.push_back(request.name.substr(6) + " " + request.node.substr(5) + std::to_string(request.instance));
        return sent;
    }

    hxal_t* fcoe = nullptr;
    hxal_t* ethernet = nullptr;
};

TEST_F(Port_Pair, goes_into_service_and_out_of_it_together)
{
    for (const hxal_t* side : {fcoe, ethernet, hxal_adapter_get_fcioc(hxal_adapter_open_idx(2), 1)})
    {
        EXPECT_EQ(hxal_port_disable(side), HXA_STATUS_OK);
        EXPECT_THAT(sent(), ElementsAre("PORT_DISABLE hxa2", "PORT_DISABLE hxn1"));
        EXPECT_EQ(hxal_port_enable(side), HXA_STATUS_OK);
        EXPECT_THAT(sent(), ElementsAre("DIAG_LB_STAT hxa2", "DIAG_LB_STAT hxn1", "PORT_ENABLE hxa2", "PORT_ENABLE hxn1"));
    }
    EXPECT_EQ(hxal_port_disable(ioc), HXA_STATUS_OK) << "an HBA's port has one side";
    EXPECT_THAT(sent(), ElementsAre("PORT_DISABLE hxa0"));
}

TEST_F(Port_Pair, tries_both_sides_and_tells_the_first_failure)
{
    const std::pair<hxa_status_t, hxa_status_t> cases[] = {
        {HXA_STATUS_DEVBUSY, HXA_STATUS_OK}, {HXA_STATUS_OK, HXA_STATUS_PBC}, {HXA_STATUS_DEVBUSY, HXA_STATUS_PBC}};
    for (const auto& [fc, eth] : cases)
    {
        hxasim::clear_faults();
        for (const char* command : {"IOCMD_PORT_ENABLE", "IOCMD_PORT_DISABLE"})
        {
            if (fc != HXA_STATUS_OK)
                hxasim::inject({.command = command, .node = "/dev/hxa", .status = static_cast<uint32_t>(fc)});
            if (eth != HXA_STATUS_OK)
                hxasim::inject({.command = command, .node = "/dev/hxn", .status = static_cast<uint32_t>(eth)});
        }
        const hxa_status_t expected = fc != HXA_STATUS_OK ? fc : eth;
        EXPECT_EQ(hxal_port_disable(fcoe), expected);
        EXPECT_EQ(hxal_port_enable(ethernet), expected);
        EXPECT_EQ(sent().size(), 6u);
    }
}

TEST_F(Port_Pair, is_not_enabled_while_a_loopback_test_holds_a_side)
{
    fail("IOCMD_DIAG_LB_STAT", EIO, 2);
    EXPECT_EQ(hxal_port_enable(fcoe), HXA_STATUS_EIO);
    EXPECT_THAT(sent(), ElementsAre("DIAG_LB_STAT hxa2"));
    hxasim::clear_faults();
    hxasim::inject({.command = "IOCMD_DIAG_LB_STAT", .node = "/dev/hxn", .status = HXA_STATUS_LEDTEST_OP});
    EXPECT_EQ(hxal_port_enable(fcoe), HXA_STATUS_LEDTEST_OP);
    EXPECT_THAT(sent(), ElementsAre("DIAG_LB_STAT hxa2", "DIAG_LB_STAT hxn1"));

    scan(R"({"adapters": [{"kind": "cna", "ports": [{"loopback_test": true, "state": "disabled"}]}]})");
    EXPECT_EQ(hxal_port_enable(ioc), HXA_STATUS_DIAG_BUSY);
    EXPECT_EQ(attributes().port_state, uint32_t{HXA_PPORT_ST_DISABLED});
}

TEST_F(Port_Pair, of_a_card_that_is_not_listed_is_not_asked)
{
    hxal_t stranger = *fcoe;
    stranger.adapter_hwpath[0] = '?';
    EXPECT_EQ(hxal_port_enable(&stranger), HXA_STATUS_FAILED);
    EXPECT_EQ(hxal_port_disable(&stranger), HXA_STATUS_FAILED);
    stranger = *fcoe;
    stranger.port_num = 2;
    EXPECT_EQ(hxal_port_enable(&stranger), HXA_STATUS_FAILED) << "no such port";
    EXPECT_EQ(hxal_port_disable(&stranger), HXA_STATUS_FAILED);
    EXPECT_EQ(hxal_port_enable(nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_port_disable(nullptr), HXA_STATUS_EINVAL);
    EXPECT_THAT(sent(), IsEmpty());
}

TEST_F(Port_Pair, has_an_ethernet_side_with_a_state_and_counters_of_its_own)
{
    scan(R"({"adapters": [{"kind": "cna", "ports": [{"mtu": 9000, "eth_state": "linkdown",
             "counters": {"ethernet_function": [1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13]}}]}]})");
    ethernet = hxal_ioc_open_idx(1);
    hxa_ethport_attr_t attr{};
    EXPECT_EQ(hxal_ethport_get_attr(ethernet, &attr), HXA_STATUS_OK);
    EXPECT_EQ(attr.mtu, 9000u);
    EXPECT_EQ(attr.port_state, uint32_t{HXA_PPORT_ST_LINKDOWN});
    EXPECT_EQ(attr.speed, 0u);
    EXPECT_EQ(attr.speed_supported, 10u);
    EXPECT_EQ(attributes().port_state, uint32_t{HXA_PPORT_ST_LINKUP});

    hxa_ethport_stats_t stats{};
    EXPECT_EQ(hxal_ethport_get_stats(ethernet, &stats), HXA_STATUS_OK);
    EXPECT_EQ(stats.txf_stats[11], 12u);
    EXPECT_EQ(stats.rxf_stats[0], 13u);
    scan(R"({"adapters": [{"kind": "fc-hba"}]})");
    EXPECT_EQ(hxal_ethport_get_attr(ioc, &attr), HXA_STATUS_CMD_NOTSUPP);
    EXPECT_EQ(hxal_ethport_get_stats(ioc, &stats), HXA_STATUS_CMD_NOTSUPP);
}

} // namespace
