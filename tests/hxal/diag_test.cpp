// Diagnostics: what is refused before a request, and what the simulated card makes of the others.
#include "simulated_host.h"

#include <cerrno>
#include <numeric>

namespace
{

using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

class Diagnostics : public Simulated_Host
{
protected:
    Diagnostics() { plug(R"({"kind": "cna"})"); }

    void plug(const std::string& adapter)
    {
        scan(R"({"adapters": [)" + adapter + "]}");
        fc = hxal_ioc_open_idx(0);
        ethernet = hxal_adapter_get_ethioc(hxal_adapter_open_idx(1), 0);
    }

    // The first port has these keys.
    void plug_port(const std::string& kind, const std::string& keys)
    {
        plug(R"({"kind": ")" + kind + R"(", "ports": [{)" + keys + "}]}");
    }

    hxa_pport_attr_t port() const
    {
        hxa_pport_attr_t attr{};
        EXPECT_EQ(hxal_port_get_attr(fc, &attr), HXA_STATUS_OK);
        return attr;
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
    EXPECT_THAT(requests(), IsEmpty());
}

TEST_F(Diagnostics, turn_the_beacon_only_when_it_changes)
{
    struct Case
    {
        const char* port;
        hxa_boolean_t beacon;
        hxa_status_t status;
    };
    // clang-format off
    const Case cases[] = {
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
        plug_port("fc-hba", keys);
        EXPECT_EQ(hxal_diag_beacon_lport(fc, beacon, 600), status);
        const auto sent = hxasim::take_requests();
        ASSERT_EQ(sent.size(), status == HXA_STATUS_OK ? 2u : 1u);
        EXPECT_EQ(sent[0].name, "IOCMD_PORT_GET_ATTR");
        if (sent.size() < 2)
            continue;
        EXPECT_EQ(sent[1].name, "IOCMD_DIAG_BEACON");
        const std::vector<std::uint8_t> record(sent[1].sent.begin() + 8, sent[1].sent.end());
        EXPECT_THAT(record, ElementsAre(beacon, 0, 0, 0, 0, 0, 0, 0, 0x58, 2, 0, 0));
        EXPECT_EQ(port().beacon, static_cast<std::uint32_t>(beacon));
    }
    fail("IOCMD_PORT_GET_ATTR", EIO);
    EXPECT_EQ(hxal_diag_beacon_lport(fc, HXA_TRUE, 0), HXA_STATUS_EIO);
    EXPECT_EQ(hxal_diag_beacon_lport(nullptr, HXA_TRUE, 0), HXA_STATUS_EINVAL);
    hxasim::clear_faults();
    EXPECT_EQ(hxal_diag_beacon_swport(fc, HXA_TRUE, 0), HXA_STATUS_OK);
    EXPECT_EQ(port().link_e2e_beacon, 1u);
}

TEST_F(Diagnostics, send_frames_around_a_disabled_port)
{
    struct Case
    {
        const char* port;
        std::uint32_t mode, speed;
        hxa_status_t fc_status, ethernet_status;
    };
    const std::uint32_t internal = HXA_PPORT_OPMODE_LB_INT, external = HXA_PPORT_OPMODE_LB_EXT, cable = HXA_PPORT_OPMODE_LB_CBL;
    // clang-format off
    const Case cases[] = {
        {R"("state": "disabled")",                           external, 10, HXA_STATUS_OK,                HXA_STATUS_OK},
        {R"("state": "disabled")",                           cable,    15, HXA_STATUS_OK,                HXA_STATUS_OK},
        {R"("state": "disabled", "speed_supported": 8)",     cable,    10, HXA_STATUS_UNSUPP_SPEED,      HXA_STATUS_OK},
        {R"("state": "disabled")",                           cable,     9, HXA_STATUS_UNSUPP_SPEED,      HXA_STATUS_OK},
        {R"("state": "disabled", "sfp": {"present": false})", internal, 1, HXA_STATUS_OK,                HXA_STATUS_CMD_NOTSUPP},
        {R"("state": "disabled", "sfp": {"present": false})", cable,    1, HXA_STATUS_NO_SFP_DEV,        HXA_STATUS_NO_SFP_DEV},
        {R"("state": "disabled", "loopback_test": true)",    external,  1, HXA_STATUS_DIAG_BUSY,         HXA_STATUS_DIAG_BUSY},
        {R"("state": "disabled", "ioc_state": "disabled")",  external,  1, HXA_STATUS_IOC_NON_OP,        HXA_STATUS_IOC_NON_OP},
        {R"()",                                              external,  1, HXA_STATUS_PORT_NOT_DISABLED, HXA_STATUS_CEE_NOT_DN},
        {R"("state": "linkdown")",                           internal,  1, HXA_STATUS_PORT_NOT_DISABLED, HXA_STATUS_CMD_NOTSUPP},
    };
    // clang-format on
    for (const auto& row : cases)
    {
        SCOPED_TRACE(std::string(row.port) + " mode " + std::to_string(row.mode));
        plug_port("cna", row.port);
        hxa_diag_loopback_result_t result{};
        EXPECT_EQ(hxal_diag_loopback(fc, row.mode, row.speed, 131072, 0xB5B5B5B5, &result), row.fc_status);
        EXPECT_EQ(result.numtxmfrm, row.fc_status == HXA_STATUS_OK ? 131072u : 0u);
        EXPECT_EQ(result.numrcvfrm, result.numtxmfrm);
        EXPECT_EQ(result.status, 0);
        result = {};
        EXPECT_EQ(hxal_diag_eth_loopback(ethernet, row.mode, 65536, 0xB5B5B5B5, &result), row.ethernet_status);
        EXPECT_EQ(result.numtxmfrm, row.ethernet_status == HXA_STATUS_OK ? 65536u : 0u);
    }
    EXPECT_EQ(hxal_diag_eth_loopback(fc, external, 1, 1, nullptr), HXA_STATUS_CMD_NOTSUPP) << "the Ethernet driver's own";
}

TEST_F(Diagnostics, test_the_memory_of_a_disabled_card)
{
    EXPECT_EQ(hxal_diag_memtest(fc, 0, nullptr), HXA_STATUS_ADAPTER_ENABLED);
    EXPECT_EQ(hxal_ioc_disable(fc), HXA_STATUS_OK);
    EXPECT_EQ(hxal_diag_memtest(fc, 0, nullptr), HXA_STATUS_ADAPTER_ENABLED) << "its other IOCs run";
    hxal_adapter_disable(1);
    hxa_diag_memtest_result_t result;
    std::memset(&result, 0xEE, sizeof result);
    EXPECT_EQ(hxal_diag_memtest(fc, 0, &result), HXA_STATUS_OK);
    EXPECT_EQ(result.status, 0u);

    hxasim::inject({.command = "IOCMD_DIAG_MEMTEST",
                    .answer = {{0, {HXA_STATUS_MEMTEST_FAILED}},
                               {16, {HXA_STATUS_DATACORRUPTED, 0, 0, 0, 0x78, 0x56, 0x34, 0x12}},
                               {44, {2}}}});
    EXPECT_EQ(hxal_diag_memtest(fc, 0, &result), HXA_STATUS_MEMTEST_FAILED);
    EXPECT_EQ(result.status, static_cast<std::uint32_t>(HXA_STATUS_DATACORRUPTED));
    EXPECT_EQ(result.addr, 0x12345678u);
    EXPECT_EQ(result.algo, 2);
}

TEST_F(Diagnostics, keep_what_is_written_to_a_register)
{
    std::uint32_t words[3] = {1, 1, 1};
    EXPECT_EQ(hxal_diag_regwrite(fc, 0x3FFF8, 0xCAFE), HXA_STATUS_OK);
    EXPECT_EQ(hxal_diag_regread(fc, 0x3FFF4, 3, words), HXA_STATUS_OK);
    EXPECT_THAT(words, ElementsAre(0, 0xCAFE, 0));
    EXPECT_EQ(hxal_diag_regread(ethernet, 0x3FFF8, 1, words), HXA_STATUS_OK);
    EXPECT_EQ(words[0], 0u) << "another function";
    EXPECT_EQ(hxal_diag_regread(fc, 0x3FFF8, 3, words), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_diag_regread(fc, 2, 1, words), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_diag_regwrite(fc, 0x40000, 1), HXA_STATUS_EINVAL);
}

TEST_F(Diagnostics, reach_the_firmware_of_a_card_that_runs)
{
    plug(R"({"kind": "fc-hba", "temperature": 71, "ports": [{}, {"ioc_state": "disabled"}]})");
    std::uint16_t temperature = 0;
    EXPECT_EQ(hxal_diag_tsensor_query(fc, &temperature), HXA_STATUS_OK);
    EXPECT_EQ(temperature, 71);
    hxa_diag_fwping_result_t ping{};
    EXPECT_EQ(hxal_diag_fwping(fc, 131072, 0xB5B5B5B5, &ping), HXA_STATUS_OK);
    EXPECT_THAT(ping.data, Each(0xB5B5B5B5));
    hxa_diag_qtest_result_t queue{};
    EXPECT_EQ(hxal_diag_queuetest(fc, 3, &queue), HXA_STATUS_OK);
    EXPECT_EQ(queue.queue, 3);
    EXPECT_EQ(hxal_diag_queuetest(fc, 4, &queue), HXA_STATUS_EINVAL);

    const hxal_t* stopped = hxal_ioc_open_idx(1);
    EXPECT_EQ(hxal_diag_tsensor_query(stopped, nullptr), HXA_STATUS_IOC_NON_OP);
    EXPECT_EQ(hxal_diag_fwping(stopped, 1, 1, nullptr), HXA_STATUS_IOC_NON_OP);
    EXPECT_EQ(hxal_diag_beacon_swport(stopped, HXA_TRUE, 0), HXA_STATUS_IOC_NON_OP);
}

TEST_F(Diagnostics, give_the_lights_to_one_at_a_time)
{
    hxa_diag_ledtest_t lights{};
    lights.cmd = 1;
    EXPECT_EQ(hxal_diag_led_test(fc, &lights), HXA_STATUS_OK);
    EXPECT_EQ(hxal_diag_led_test(ethernet, &lights), HXA_STATUS_LEDTEST_OP);
    EXPECT_EQ(hxal_diag_beacon_lport(fc, HXA_TRUE, 0), HXA_STATUS_LEDTEST_OP);
    lights.cmd = 0;
    EXPECT_EQ(hxal_diag_led_test(fc, &lights), HXA_STATUS_OK);
    EXPECT_EQ(hxal_diag_beacon_lport(fc, HXA_TRUE, 0), HXA_STATUS_OK);
    lights.cmd = 1;
    EXPECT_EQ(hxal_diag_led_test(fc, &lights), HXA_STATUS_BEACON_ON);
}

template <typename Block> bool is_sealed(const Block& block)
{
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&block);
    return std::accumulate(bytes, bytes + sizeof block - 1, 0) % 256 == bytes[sizeof block - 1];
}

TEST_F(Diagnostics, read_the_memory_of_a_transceiver)
{
    sfp_mem_t sfp{};
    EXPECT_EQ(hxal_diag_sfp_query(ethernet, &sfp), HXA_STATUS_OK);
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&sfp);
    EXPECT_EQ(bytes[0], 3) << "SFP";
    EXPECT_EQ(bytes[3], 0x10) << "10GBASE-SR";
    EXPECT_EQ(std::string(bytes + 20, bytes + 36), "ZEMLAR          ");
    EXPECT_EQ(std::string(bytes + 68, bytes + 84), "ZMC0000001-0    ");
    EXPECT_TRUE(is_sealed(sfp.serial_id_base));
    EXPECT_TRUE(is_sealed(sfp.serial_id_ext));
    EXPECT_TRUE(is_sealed(sfp.diag_base));
    EXPECT_EQ(bytes[192], 35) << "degrees";

    plug_port("fc-hba", R"("sfp": {"media": "lw", "part_number": "PN-1", "revision": "B2", "fc_speeds": 133, "memory": "01AA"})");
    hxa_defs_sfp_media_t media{};
    EXPECT_EQ(hxal_diag_sfp_query(fc, &sfp), HXA_STATUS_OK);
    EXPECT_EQ(bytes[1], 0xAA);
    EXPECT_EQ(std::string(bytes + 40, bytes + 60), "PN-1            B2  ");
    EXPECT_EQ(hxal_sfp_media(fc, &media), HXA_STATUS_OK);
    EXPECT_EQ(media, HXA_SFP_MEDIA_LW);
    for (std::uint32_t speed : {1u, 2u, 10u, 15u})
        EXPECT_EQ(hxal_sfp_speed(fc, speed), HXA_STATUS_OK) << speed;
    for (std::uint32_t speed : {0u, 4u, 8u, 16u})
        EXPECT_EQ(hxal_sfp_speed(fc, speed), HXA_STATUS_UNSUPP_SPEED) << speed;

    plug_port("fc-hba", R"("sfp": {"present": false})");
    EXPECT_EQ(hxal_diag_sfp_query(fc, &sfp), HXA_STATUS_NO_SFP_DEV);
    EXPECT_EQ(hxal_sfp_media(fc, &media), HXA_STATUS_NO_SFP_DEV);
    EXPECT_EQ(hxal_sfp_speed(fc, 8), HXA_STATUS_NO_SFP_DEV);
    plug_port("fc-hba", R"("sfp": {"media": "unsupported"})");
    EXPECT_EQ(hxal_sfp_speed(fc, 8), HXA_STATUS_SFP_UNSUPP);
}

} // namespace
