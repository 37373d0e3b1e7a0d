// The two functions of a physical port, together.
#include "tests/hxal/library_fixture.h"

#include <cerrno>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;

// A CNA with an HBA before it, so that instances and list indexes differ: FCoE 1 and 2, Ethernet 0 and 1.
class Port_Pair : public Library_Test
{
protected:
    Port_Pair()
    {
        scan(R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}, {"kind": "cna"}]})");
        ioc = hxal_ioc_open_idx(0);
        fcoe = hxal_ioc_open_idx(2);
        ethernet = hxal_ioc_open_idx(4);
        EXPECT_EQ(ethernet->port_num, fcoe->port_num);
    }

    hxal_t* ioc = nullptr; // of the HBA
    hxal_t* fcoe = nullptr;
    hxal_t* ethernet = nullptr;
};

TEST_F(Port_Pair, goes_into_service_and_out_of_it_together)
{
    for (const hxal_t* side : {fcoe, ethernet, hxal_adapter_get_fcioc(hxal_adapter_open_idx(2), 1)})
    {
        EXPECT_EQ(hxal_port_disable(side), HXA_STATUS_OK);
        EXPECT_THAT(requests(), ElementsAre("IOCMD_PORT_DISABLE /dev/hxa 2", "IOCMD_PORT_DISABLE /dev/hxn 1"));
        EXPECT_EQ(hxal_port_enable(side), HXA_STATUS_OK);
        EXPECT_THAT(requests(), ElementsAre("IOCMD_DIAG_LB_STAT /dev/hxa 2", "IOCMD_DIAG_LB_STAT /dev/hxn 1",
                                            "IOCMD_PORT_ENABLE /dev/hxa 2", "IOCMD_PORT_ENABLE /dev/hxn 1"));
    }
    EXPECT_EQ(hxal_port_disable(ioc), HXA_STATUS_OK) << "an HBA's port has one side";
    EXPECT_THAT(requests(), ElementsAre("IOCMD_PORT_DISABLE /dev/hxa 0"));
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
                answer(command, static_cast<uint32_t>(fc), "/dev/hxa");
            if (eth != HXA_STATUS_OK)
                answer(command, static_cast<uint32_t>(eth), "/dev/hxn");
        }
        const hxa_status_t expected = fc != HXA_STATUS_OK ? fc : eth;
        EXPECT_EQ(hxal_port_disable(fcoe), expected);
        EXPECT_EQ(hxal_port_enable(ethernet), expected);
        EXPECT_EQ(requests().size(), 6u);
    }
}

TEST_F(Port_Pair, is_not_enabled_while_a_loopback_test_holds_a_side)
{
    fail("IOCMD_DIAG_LB_STAT", EIO, 2);
    EXPECT_EQ(hxal_port_enable(fcoe), HXA_STATUS_EIO);
    EXPECT_THAT(requests(), ElementsAre("IOCMD_DIAG_LB_STAT /dev/hxa 2"));
    hxasim::clear_faults();
    answer("IOCMD_DIAG_LB_STAT", HXA_STATUS_LEDTEST_OP, "/dev/hxn");
    EXPECT_EQ(hxal_port_enable(fcoe), HXA_STATUS_LEDTEST_OP);
    EXPECT_THAT(requests(), ElementsAre("IOCMD_DIAG_LB_STAT /dev/hxa 2", "IOCMD_DIAG_LB_STAT /dev/hxn 1"));
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
    EXPECT_THAT(requests(), IsEmpty());
}

} // namespace
