// Scenario files: how they are found, and the errors that name the place.
#include "tests/sim/simulated_host.h"

#include <fstream>
#include <numeric>

namespace
{

using Scenarios = Raw_Host;

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
        {R"({"adapters": [{"kind": "hba"}]})", "adapters[0].kind: must be one of fc-hba, cna, mezzanine"},
        {R"({"adapters": [{"kind": "cna", "serial": "1234567890123"}]})",
         "adapters[0].serial: must be a text of at most 12 bytes"},
        {R"({"adapters": [{"kind": "cna", "is_mezz": 1}]})", "adapters[0].is_mezz: must be true or false"},
        {R"({"adapters": [{"kind": "cna", "ports": [{}, {"speed": -1}]}]})",
         "adapters[0].ports[1].speed: must be a whole number from 0 to 4294967295"},
        {R"({"adapters": [{"kind": "cna", "ports": [{"pwwn": "200000051E12345"}]}]})",
         "adapters[0].ports[0].pwwn: must be 16 hexadecimal digits"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"fc_instance": 1}, {"fc_instance": 1}]}]})",
         "adapters[0].ports[1].fc_instance: instance 1 of /dev/hxa is taken"},
        {R"({"adapters": [{"kind": "fc-hba", "vpd": {"data": "8"}}]})",
         "adapters[0].vpd.data: must be at most 512 bytes as hexadecimal digits"},
        {R"({"drivers": {"hxa": {"version": "1020"}}})", "drivers.hxa.version: must be a whole number from 0 to 4294967295"},
        {R"({"generate": {"kind": "cna", "adapters": 65}})", "generate.adapters[64].ports[0]: more than 128 IOCs on /dev/hxa"},
        {R"({"faults": [{"command": "IOCMD_NO", "error": "EIO"}]})", "faults[0].command: no such command: IOCMD_NO"},
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

TEST_F(Scenarios, hold_texts_that_are_none_and_counters_that_differ)
{
    hxasim::load_text(
        R"({"adapters": [{"kind": "fc-hba", "serial": {"hex": "41FF00"}, "ports": [{"counters": {"from": 100}}]}]})");
    Open_File hxa("/dev/hxa");
    EXPECT_EQ(digits_of(info(hxa, 'C', 0).serialnum).substr(0, 8), "41FF0000");
    hxa_pport_stats_t counters{};
    hxa_ioctl_port_stats_t record{};
    record.buf_size = sizeof(counters);
    record.buf_ptr = reinterpret_cast<std::uintptr_t>(&counters);
    EXPECT_EQ(send(*hxa, "IOCMD_PORT_GET_STATS", 'C', record), 0);
    EXPECT_EQ(counters.fc.tx_frames, 101U);
    EXPECT_EQ(counters.fc.err_enc, 128U);
}

TEST_F(Scenarios, carry_vital_product_data_that_holds_together)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "fru_number": "FRU1234567890ABC"}]})");
    const auto vpd = ask<hxa_ioctl_ioc_attr_t>(Open_File("/dev/hxa"), "IOCMD_IOC_GET_ATTR", 'C', 0).attr.adapter_attr.vpd;
    const std::string data(std::begin(vpd.data), std::end(vpd.data));
    EXPECT_THAT(data.substr(175), testing::StartsWith("FRU1234567890ABC"));
    EXPECT_EQ(std::accumulate(vpd.data, vpd.data + data.find("RV") + 4, 0) % 256, 0);
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
