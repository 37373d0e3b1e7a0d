// Diagnostics: what is refused before a request, and the beacon, which is looked at before it is turned. The rest stands in the
// table of operations.
#include "tests/hxal/library_fixture.h"

#include <cerrno>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;

class Diagnostics : public Library_Test
{
protected:
    Diagnostics() { plug(""); }

    // A CNA whose only port has these keys.
    void plug(const std::string& keys)
    {
        scan(R"({"adapters": [{"kind": "cna", "ports": [{)" + keys + "}]}]}");
        fc = hxal_ioc_open_idx(0);
        ethernet = hxal_ioc_open_idx(1);
    }

    const hxal_t* fc = nullptr;
    const hxal_t* ethernet = nullptr;
};

TEST_F(Diagnostics, that_no_driver_offers_are_refused_without_a_request)
{
    for (std::uint32_t mode : {0u, 2u, 3u, 16u, 32u, 0xFFFFFFFFu})
    {
        EXPECT_EQ(hxal_diag_loopback(fc, mode, 4, 1, 1, nullptr), HXA_STATUS_CMD_NOTSUPP) << mode;
        EXPECT_EQ(hxal_diag_eth_loopback(ethernet, mode, 1, 1, nullptr), HXA_STATUS_CMD_NOTSUPP) << mode;
    }
    EXPECT_EQ(hxal_diag_eth_loopback(ethernet, HXA_PPORT_OPMODE_LB_INT, 1, 1, nullptr), HXA_STATUS_CMD_NOTSUPP);
    for (std::uint32_t speed : {16u, 0xFFFFFFFFu})
        EXPECT_EQ(hxal_diag_loopback(fc, HXA_PPORT_OPMODE_LB_INT, speed, 1, 1, nullptr), HXA_STATUS_EINVAL) << speed;
    EXPECT_EQ(hxal_diag_post(fc, nullptr), HXA_STATUS_CMD_NOTSUPP);
    EXPECT_EQ(hxal_diag_pom_query(nullptr, nullptr), HXA_STATUS_CMD_NOTSUPP);
    std::uint32_t word = 0;
    EXPECT_EQ(hxal_diag_regread(fc, 0, -1, &word), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_diag_regread(fc, 0, 1, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_diag_led_test(fc, nullptr), HXA_STATUS_EINVAL);
    EXPECT_THAT(commands(), IsEmpty());
}

TEST_F(Diagnostics, are_refused_while_what_they_test_is_in_service)
{
    EXPECT_EQ(hxal_diag_loopback(fc, HXA_PPORT_OPMODE_LB_INT, HXA_PPORT_SPEED_4GBPS, 1, 1, nullptr),
              HXA_STATUS_PORT_NOT_DISABLED);
    EXPECT_EQ(hxal_diag_eth_loopback(ethernet, HXA_PPORT_OPMODE_LB_CBL, 1, 1, nullptr), HXA_STATUS_CEE_NOT_DN);
    EXPECT_EQ(hxal_diag_memtest(fc, 1, nullptr), HXA_STATUS_ADAPTER_ENABLED);
}

TEST_F(Diagnostics, turn_the_beacon_only_when_it_changes)
{
    // clang-format off
    const std::tuple<const char*, hxa_boolean_t, hxa_status_t> cases[] = {
        {R"()",                                      HXA_TRUE,  HXA_STATUS_OK},
        {R"("beacon": true)",                        HXA_TRUE,  HXA_STATUS_BEACON_ON},
        {R"("link_beacon": true)",                   HXA_TRUE,  HXA_STATUS_LBEACON_ON},
        {R"("beacon": true, "link_beacon": true)",   HXA_TRUE,  HXA_STATUS_LBEACON_ON},
        {R"()",                                      HXA_FALSE, HXA_STATUS_BEACON_OFF},
        {R"("link_beacon": true)",                   HXA_FALSE, HXA_STATUS_BEACON_OFF},
        {R"("beacon": true)",                        HXA_FALSE, HXA_STATUS_OK},
        {R"("beacon": true, "link_beacon": true)",   HXA_FALSE, HXA_STATUS_LBEACON_ON},
    };
    // clang-format on
    for (const auto& [keys, beacon, status] : cases)
    {
        SCOPED_TRACE(std::string(keys) + (beacon ? " on" : " off"));
        plug(keys);
        EXPECT_EQ(hxal_diag_beacon_lport(fc, beacon, 600), status);
        const auto sent = hxasim::take_requests();
        ASSERT_EQ(sent.size(), status == HXA_STATUS_OK ? 2u : 1u);
        EXPECT_EQ(sent[0].name, "IOCMD_PORT_GET_ATTR");
        if (sent.size() < 2)
            continue;
        EXPECT_EQ(sent[1].name, "IOCMD_DIAG_BEACON");
        const std::vector<std::uint8_t> record(sent[1].sent.begin() + 8, sent[1].sent.end());
        EXPECT_THAT(record, ElementsAre(beacon, 0, 0, 0, 0, 0, 0, 0, 0x58, 2, 0, 0));
    }
    fail("IOCMD_PORT_GET_ATTR", EIO);
    EXPECT_EQ(hxal_diag_beacon_lport(fc, HXA_TRUE, 0), HXA_STATUS_EIO);
    EXPECT_EQ(hxal_diag_beacon_lport(nullptr, HXA_TRUE, 0), HXA_STATUS_EINVAL);
}

} // namespace
