// Scenario files: the shipped ones, what they must hold, and the errors that name the place.
#include "tests/sim/simulated_host.h"

#include <fstream>
#include <set>
#include <stdexcept>
#include <tuple>

namespace
{

class Scenarios : public Simulated_Host
{
protected:
    static std::string refusal(const std::string& json)
    {
        try
        {
            hxasim::load_text(json);
        }
        catch (const std::runtime_error& error)
        {
            return error.what();
        }
        return "accepted";
    }
};

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

TEST_F(Scenarios, deliver_texts_that_fill_their_field_without_terminator)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba", "serial": "123456789012", "manufacturer": "12345678"}]})");
    auto card = attributes(Open_File("/dev/hxa"), 'C', 0).adapter_attr;
    EXPECT_EQ(std::string(card.serial_num, 12), "123456789012");
    EXPECT_EQ(std::string(card.manufacturer, 8), "12345678");
}

TEST_F(Scenarios, name_the_place_of_every_error)
{
    const std::pair<const char*, const char*> cases[] = {
        {R"([])", "scenario: must be an object"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"counters": {"fc": [-1]}}]}]})",
         "adapters[0].ports[0].counters.fc: must be a list of at most 29 whole numbers from 0 to 18446744073709551615"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"counters": {"ethernet": []}}]}]})",
         "adapters[0].ports[0].counters.ethernet: unknown key"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": [{}, {"nexus": {"state": "up"}}]}]}]})",
         "adapters[0].ports[0].remote_ports[1].nexus.state: must be one of offline, prli-send, prli-sent, prli-retry, "
         "hcb-online, online, hcb-offline, initiator, or a whole number from 0 to 4294967295"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": {"luns": [{"count": 3}, {"lun": 2}]}}]}]})",
         "adapters[0].ports[0].remote_ports.luns[1]: LUN 2 is taken"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"remote_ports": {"luns": {"lun": 9, "count": 65528}}}]}]})",
         "adapters[0].ports[0].remote_ports.luns: LUNs beyond 65535"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"sfp": {"media": 6, "fc_speed": 1}}]}]})",
         "adapters[0].ports[0].sfp.fc_speed: unknown key"},
        {R"({"adaptors": []})", "adaptors: unknown key"},
        {R"({"adapters": 1})", "adapters: must be a list of at most 128 objects"},
        {R"({"adapters": [{"kind": "cna"}, 7]})", "adapters[1]: must be an object"},
        {R"({"adapters": [{}]})", "adapters[0].kind: must be one of fc-hba, cna, mezzanine"},
        {R"({"adapters": [{"kind": "hba"}]})", "adapters[0].kind: must be one of fc-hba, cna, mezzanine"},
        {R"({"adapters": [{"kind": "cna", "serial": "1234567890123"}]})",
         "adapters[0].serial: must be a text of at most 12 bytes"},
        {R"({"adapters": [{"kind": "cna", "is_mezz": 1}]})", "adapters[0].is_mezz: must be true or false"},
        {R"({"adapters": [{"kind": "cna", "ports": [{}, {"speed": -1}]}]})",
         "adapters[0].ports[1].speed: must be a whole number from 0 to 4294967295"},
        {R"({"adapters": [{"kind": "cna", "ports": [{"max_frame_size": 65536}]}]})",
         "adapters[0].ports[0].max_frame_size: must be a whole number from 0 to 65535"},
        {R"({"adapters": [{"kind": "cna", "ports": [{"topology": "ring"}]}]})",
         "adapters[0].ports[0].topology: must be one of none, p2p, loop, auto, or a whole number from 0 to 4294967295"},
        {R"({"adapters": [{"kind": "cna", "ports": [{"pwwn": "200000051E12345"}]}]})",
         "adapters[0].ports[0].pwwn: must be 16 hexadecimal digits"},
        {R"({"adapters": [{"kind": "cna", "ports": [{"mac": "00:05:1E:00:00"}]}]})",
         "adapters[0].ports[0].mac: must be 12 hexadecimal digits"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"mac": "00051E000000"}]}]})", "adapters[0].ports[0].mac: unknown key"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"fc_instance": 1}, {"fc_instance": 1}]}]})",
         "adapters[0].ports[1].fc_instance: instance 1 of /dev/hxa is taken"},
        {R"({"adapters": [{"kind": "fc-hba", "ports": [{"fc_instance": 128}]}]})",
         "adapters[0].ports[0].fc_instance: must be a whole number from 0 to 127"},
        {R"({"adapters": [{"kind": "fc-hba", "vpd": {"data": "8"}}]})",
         "adapters[0].vpd.data: must be at most 512 bytes as hexadecimal digits"},
        {R"({"adapters": [{"kind": "fc-hba", "vpd": {}, "fru_number": "X"}]})", "adapters[0].fru_number: unknown key"},
        {R"({"drivers": {"hxa": {"version": "1020"}}})", "drivers.hxa.version: must be a whole number from 0 to 4294967295"},
        {R"({"drivers": {"hxb": {}}})", "drivers.hxb: unknown key"},
        {R"({"generate": {"kind": "cna", "adapters": 65}})", "generate.adapters[64].ports[0]: more than 128 IOCs on /dev/hxa"},
        {R"({"generate": {"kind": "cna", "ports": 9}})", "generate.ports: must be a whole number from 0 to 8"},
        {R"({"faults": [{"command": "IOCMD_NO", "error": "EIO"}]})", "faults[0].command: no such command: IOCMD_NO"},
        {R"({"faults": [{"error": "EWHAT"}]})",
         "faults[0].error: must be one of EINTR, EIO, ENXIO, EBADF, EAGAIN, ENOMEM, EACCES, EFAULT, EBUSY, ENODEV, EINVAL, "
         "ENOTTY, or a whole number from 0 to 4095"},
        {R"({"faults": [{"error": 5, "answer": [{"offset": 0, "bytes": "0G"}]}]})",
         "faults[0].answer[0].bytes: must be at most 4372 bytes as hexadecimal digits"},
    };
    hxasim::load("cna");
    for (const auto& [json, message] : cases)
        EXPECT_EQ(refusal(json), message) << json;
    EXPECT_THAT(refusal("{\"adapters\":\n [}"), testing::HasSubstr("line 2, column 3"));
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 2U) << "a refused scenario must not replace the host";
}

TEST_F(Scenarios, are_found_by_name_or_by_path)
{
    std::string path = testing::TempDir() + "sim_scenario_test.json";
    std::ofstream(path) << R"({"adapters": [{"kind": "fc-hba", "ports": [{}]}]})";
    hxasim::load(path);
    EXPECT_EQ(instances(Open_File("/dev/hxa"), 'C').first, 1U);
    std::ofstream(path) << R"({"adapters": 1})";
    for (const auto& [name, message] : {std::pair<std::string, std::string>{"fc_hba", "fc_hba: no such shipped scenario"},
                                        {"/no/such.json", "/no/such.json: No such file or directory"},
                                        {"/dev/zero", "/dev/zero: not a regular file"},
                                        {path, path + ": adapters: must be a list of at most 128 objects"}})
    {
        try
        {
            hxasim::load(name);
            ADD_FAILURE() << "loaded " << name;
        }
        catch (const std::runtime_error& error)
        {
            EXPECT_EQ(error.what(), message);
        }
    }
    unlink(path.c_str());
}

} // namespace
