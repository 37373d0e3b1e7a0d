// Scenario files: the shipped ones, what they must hold, and the errors that name the place.
#include "tests/sim/simulated_host.h"

#include <fstream>
#include <numeric>
#include <set>
#include <tuple>

namespace
{

using Scenarios = Simulated_Host;

TEST_F(Scenarios, shipped_ones_hold_their_iocs)
{
    const std::tuple<const char*, std::uint32_t, std::uint32_t> shipped[] = {
        {"fc-hba", 2, 0}, {"cna", 2, 2}, {"mixed", 8, 4}, {"large", 128, 128}, {"version-refused", 2, 2}};
    for (const auto& [name, fc, ethernet] : shipped)
    {
        SCOPED_TRACE(name);
        hxasim::load(name);
        EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, fc);
        EXPECT_EQ(instances(Open_File("/dev/hxn"), 'D').first, ethernet);
    }
}

TEST_F(Scenarios, mixed_one_has_links_in_every_state)
{
    using Link = std::tuple<std::uint32_t, std::uint32_t, std::uint32_t, std::uint16_t>; // state, speed, topology, frame size
    // clang-format off
    const Link expected[] = {
        {HXA_PPORT_ST_LINKUP,           10, HXA_PPORT_TOPOLOGY_P2P,  2112},
        {HXA_PPORT_ST_LINKDOWN,          0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_LINKUP,            2, HXA_PPORT_TOPOLOGY_LOOP, 2112},
        {HXA_PPORT_ST_DISABLED,          0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_LINKUP,           10, HXA_PPORT_TOPOLOGY_P2P,  1024},
        {HXA_PPORT_ST_PREBOOT_DISABLED,  0, HXA_PPORT_TOPOLOGY_NONE, 2112},
        {HXA_PPORT_ST_IOCDIS,            0, HXA_PPORT_TOPOLOGY_NONE, 2112},
    };
    // clang-format on
    hxasim::load("mixed");
    Open_File hxa("/dev/hxa");
    for (std::uint16_t instance = 0; instance < std::size(expected); ++instance)
    {
        const auto link = port(hxa, 'C', instance);
        EXPECT_EQ(Link(link.port_state, link.speed, link.topology, link.pport_cfg.maxfrsize), expected[instance]) << instance;
    }
    EXPECT_EQ(port(hxa, 'C', 2).beacon, 1U);
}

// Reads the block as its consumer does: sections at fixed places, keywords after one another, a checksum over all.
TEST_F(Scenarios, carry_vital_product_data_that_holds_together)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "fru_number": "FRU1234567890ABC"}]})");
    auto vpd = attributes(Open_File("/dev/hxa"), 'C', 0).adapter_attr.vpd;
    EXPECT_EQ(vpd.vendor, 0);
    EXPECT_EQ(vpd.data[0], 0x82);
    EXPECT_EQ(vpd.data[131], 0x90);
    std::string data(std::begin(vpd.data), std::end(vpd.data));
    EXPECT_THAT(data.substr(134), testing::StartsWith("V0"));
    EXPECT_THAT(data.substr(153), testing::StartsWith("V1"));
    EXPECT_THAT(data.substr(156 + 19), testing::StartsWith("FRU1234567890ABC"));
    auto checksum_end = data.find("RV") + 4;
    auto section_end = static_cast<std::size_t>(134 + vpd.data[132] + 256 * vpd.data[133]);
    EXPECT_EQ(checksum_end, section_end);
    EXPECT_EQ(std::accumulate(vpd.data, vpd.data + checksum_end, 0) % 256, 0);
}

TEST_F(Scenarios, generated_adapters_are_all_different)
{
    hxasim::load("large");
    Open_File hxa("/dev/hxa");
    Open_File hxn("/dev/hxn");
    std::set<std::string> serials, paths, names, addresses;
    for (std::uint16_t instance = 0; instance < 128; ++instance)
    {
        auto fcoe = info(hxa, 'C', instance);
        auto ethernet = info(hxn, 'D', instance);
        serials.insert(text_of(fcoe.serialnum));
        paths.insert(text_of(fcoe.hwpath));
        paths.insert(text_of(ethernet.hwpath));
        names.insert(text_of(ethernet.eth_name));
        addresses.insert({digits_of(fcoe.pwwn), digits_of(fcoe.nwwn), digits_of(fcoe.mac), digits_of(ethernet.mac)});
    }
    EXPECT_EQ(serials.size(), 64U);
    EXPECT_EQ(paths.size(), 256U);
    EXPECT_EQ(names.size(), 128U);
    EXPECT_EQ(addresses.size(), 512U);
}

TEST_F(Scenarios, name_the_place_of_every_error)
{
    const std::pair<const char*, const char*> cases[] = {
        {R"([])", "scenario: must be an object"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"counters": {"fc": [-1]}}]}]})",
         "adapters[0].ports[0].counters.fc: must be a list of at most 29 whole numbers from 0 to 18446744073709551615"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [{}, {"nexus": {"state": "up"}}]}]}]})",
         "adapters[0].ports[0].remote_ports[1].nexus.state: must be one of offline, prli-send, prli-sent, prli-retry, "
         "hcb-online, online, hcb-offline, initiator, or a whole number from 0 to 4294967295"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": {"luns": [{"count": 3}, {"lun": 2}]}}]}]})",
         "adapters[0].ports[0].remote_ports.luns[1]: LUN 2 is taken"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": {"luns": {"lun": 9, "count": 65528}}}]}]})",
         "adapters[0].ports[0].remote_ports.luns: LUNs beyond 65535"},
        {R"({"adaptors": []})", "adaptors: unknown key"},
        {R"({"adapters": 1})", "adapters: must be a list of at most 128 objects"},
        {R"({"adapters": [{"kind": "cna"}, 7]})", "adapters[1]: must be an object"},
        {R"({"adapters": [{"kind": "hba"}]})", "adapters[0].kind: must be one of fc-hba, cna, mezzanine"},
        {R"({"adapters": [{"kind": "cna", "serial": "1234567890123"}]})",
         "adapters[0].serial: must be a text of at most 12 bytes"},
        {R"({"adapters": [{"kind": "cna", "is_mezz": 1}]})", "adapters[0].is_mezz: must be true or false"},
        {R"({"adapters": [{"kind": "cna", "ports": [{}, {"speed": -1}]}]})",
         "adapters[0].ports[1].speed: must be a whole number from 0 to 4294967295"},
        {R"({"adapters": [{"kind": "cna", "ports": [{"pwwn": "200000051E12345"}]}]})",
         "adapters[0].ports[0].pwwn: must be 16 hexadecimal digits"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"mac": "00051E000000"}]}]})", "adapters[0].ports[0].mac: unknown key"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"fc_instance": 1}, {"fc_instance": 1}]}]})",
         "adapters[0].ports[1].fc_instance: instance 1 of /dev/hxa is taken"},
        {R"({"adapters": [{"kind": "fc-hba", "vpd": {"data": "8"}}]})",
         "adapters[0].vpd.data: must be at most 512 bytes as hexadecimal digits"},
        {R"({"drivers": {"hxa": {"version": "1020"}}})", "drivers.hxa.version: must be a whole number from 0 to 4294967295"},
        {R"({"generate": {"kind": "cna", "adapters": 65}})", "generate.adapters[64].ports[0]: more than 128 IOCs on /dev/hxa"},
        {R"({"faults": [{"command": "IOCMD_NO", "error": "EIO"}]})", "faults[0].command: no such command: IOCMD_NO"},
        {R"({"faults": [{"error": "EWHAT"}]})",
         "faults[0].error: must be one of EINTR, EIO, ENXIO, EBADF, EAGAIN, ENOMEM, EACCES, EFAULT, EBUSY, ENODEV, EINVAL, "
         "ENOTTY, or a whole number from 0 to 4095"},
        {R"({"faults": [{"error": 5, "answer": [{"offset": 0, "bytes": "0G"}]}]})",
         "faults[0].answer[0].bytes: must be at most 4372 bytes as hexadecimal digits"},
    };
    hxasim::load("cna");
    const auto load_text = [](const std::string& json) { return refusal_of([&] { hxasim::load_text(json); }); };
    for (const auto& [json, message] : cases)
        EXPECT_EQ(load_text(json), message) << json;
    EXPECT_THAT(load_text("{\"adapters\":\n [}"), testing::HasSubstr("line 2, column 3"));
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 2U) << "a refused scenario must not replace the host";
}

TEST_F(Scenarios, are_found_by_name_or_by_path)
{
    std::string path = testing::TempDir() + "sim_scenario_test.json";
    std::ofstream(path) << R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}]})";
    hxasim::load(path);
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 1U);
    std::ofstream(path) << R"({"adapters": 1})";
    const std::pair<std::string, std::string> refused[] = {{"fc_hba", "fc_hba: no such shipped scenario"},
                                                           {"/no/such.json", "/no/such.json: No such file or directory"},
                                                           {"/dev/zero", "/dev/zero: not a regular file"},
                                                           {path, path + ": adapters: must be a list of at most 128 objects"}};
    for (const auto& row : refused)
        EXPECT_EQ(refusal_of([&] { hxasim::load(row.first); }), row.second);
    unlink(path.c_str());
}

} // namespace
