// What is left when the memory ends in the middle of a scan, or of a virtual port's line.
#include "allocations.h"
#include "tests/hxal/library_fixture.h"

namespace
{

using Memory = Library_Test;

TEST_F(Memory, that_ends_in_a_node_scan_costs_that_node)
{
    host(one_cna); // allocations 1 and 2: the FC node, 3 and 4: the Ethernet node
    for (int allocation : {1, 2, 3, 4})
    {
        allocations::fail_library_node(allocation);
        EXPECT_EQ(hxal_ioc_scan(), 2) << allocation;
        EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_ENOMEM);
        EXPECT_EQ(hxal_ioc_open_idx(0)->ioc_type, allocation > 2 ? HXA_IOC_TYPE_FCoE : HXA_IOC_TYPE_LL);
        EXPECT_EQ(hxasim::open_descriptors(), 1);
        hxal_set_last_error(HXA_STATUS_OK);
    }
}

TEST_F(Memory, that_ends_in_the_adapter_scan_leaves_no_adapter)
{
    host(one_cna); // allocation 5: the adapter, 6 to 9: its IOC copies
    for (int allocation : {5, 6, 9})
    {
        allocations::fail_library_node(allocation);
        EXPECT_EQ(hxal_adapter_scan(), 0) << allocation;
        EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_ENOMEM);
        EXPECT_EQ(hxal_adapter_get_num(), 0u);
        EXPECT_EQ(hxal_ioc_get_num(), 4);
        hxal_set_last_error(HXA_STATUS_OK);
    }
    allocations::fail_library_node(0);
    EXPECT_EQ(hxal_adapter_scan(), 1);
    EXPECT_EQ(hxasim::open_descriptors(), 2);
}

TEST_F(Memory, that_ends_in_a_virtual_port_drops_its_line)
{
    allocations::fail_library_node(2);
    for (const char* line : {"10:01,a,b,c,1", "10:02,a,b,c,1", "10:03,a,b,c,1"})
        hxal_config_set_vportdata(0, line);
    const hxal_ioc_config_t& entry = hxal_config_get()->iocs[0];
    EXPECT_EQ(entry.vpcount, 2);
    EXPECT_STREQ(entry.vport->next->pwwn, "10:03");
    EXPECT_EQ(entry.vport->next->next, nullptr);
}

} // namespace
