// What a line, and a whole file, does to the model.
#include "config_fixture.h"
#include "tests/hxal/golden.h"

#include <sstream>
#include <sys/stat.h>
#include <thread>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;
using Config_Parser = Config_Model;

TEST_F(Config_Parser, takes_values_in_every_form_and_drops_those_that_are_none)
{
    std::istringstream rows(golden("config_lines.txt"));
    for (std::string line, written_line; std::getline(rows, line) && std::getline(rows, written_line);)
    {
        empty_model();
        hxal_config_parse(line.c_str());
        EXPECT_EQ(settings(), written_line == "-" ? std::vector<std::string>() : std::vector{written_line}) << line;
    }
}

TEST_F(Config_Parser, stores_values_as_numbers)
{
    parse({"hxa3-port-topology = auto", "hxa3-log-level = Info", "hxa3-auth-algo = ms", "hxa3-auth-secretsource = RADIUS",
           "hxa3-qos = TRUE", "hxa3-qos = maybe", "msix-disable = 11;", "pcie-max-read-reqsz = 12;"});
    EXPECT_EQ(hxal_config_get()->tuning.msix_disable, 11);
    EXPECT_EQ(hxal_config_get()->tuning.pcie_max_read_reqsz, 12);
    EXPECT_FALSE(has(ioc(3).flags, HXAL_CONFIG_QOS)) << "a later word that is none";
    EXPECT_EQ(ioc(3).topology, uint32_t{HXA_PPORT_TOPOLOGY_AUTO});
    EXPECT_EQ(ioc(3).log, HXA_LOG_INFO);
    EXPECT_EQ(ioc(3).authalgo, uint32_t{HXA_AUTH_ALGO_MS});
    EXPECT_EQ(ioc(3).authssource, uint32_t{HXA_AUTH_SECSRC_RADIUS});
}

TEST_F(Config_Parser, ignores_what_does_not_fit)
{
    std::istringstream lines(golden("no_config_lines.txt"));
    for (std::string line; std::getline(lines, line);)
        hxal_config_parse(line.c_str());
    hxal_config_parse(nullptr);
    EXPECT_THAT(settings(), IsEmpty());
    EXPECT_EQ(hxal_config_ad_get_num() + hxal_config_ioc_get_num(), 0);
}

TEST_F(Config_Parser, takes_a_line_for_the_first_kind_that_it_contains)
{
    parse({"hxn5-port-name = \"hxa-uplink\"", "note hxa4-port-name = \"adapter-x\"", "qos = TRUE hxa7-"});
    EXPECT_STREQ(ioc(5).name, "hxa-uplink");
    EXPECT_STREQ(ioc(4).name, "");
    EXPECT_EQ(hxal_config_ad_lookup("port"), 0);
    EXPECT_FALSE(has(hxal_config_get()->config_all, HXAL_CONFIG_QOS));
}

TEST_F(Config_Parser, makes_an_entry_of_every_adapter_line)
{
    parse({"adapter-SN0123456789-name = \"Blue\";", "adapter-SN2-power = 2;", "adapter-SN0123456789-power = 3;"});
    EXPECT_EQ(hxal_config_ad_get_num(), 3);
    EXPECT_EQ(hxal_config_ad_lookup("SN0123456789"), 0);
    EXPECT_EQ(hxal_config_ad_lookup("SN012345678"), -1);
    EXPECT_EQ(hxal_config_ad_lookup("SN2"), 1);
    EXPECT_EQ(hxal_config_ad_lookup("SN3"), -1);
    EXPECT_EQ(hxal_config_ad_lookup(nullptr), -1);
    EXPECT_THAT(settings(), ElementsAre("adapter-SN0123456789-name = \"Blue\";", "adapter-SN2-power = 2;",
                                        "adapter-SN0123456789-power = 3;"));
    parse({"adapter-SN4-power = 1;"}); // writing has made entry 0 the next
    EXPECT_EQ(hxal_config_ad_lookup("SN4"), 0);
    for (const char* serial : {"", "SN5", static_cast<const char*>(nullptr)})
        hxal_config_ad_add(serial);
    EXPECT_EQ(hxal_config_ad_get_num(), 4);
    EXPECT_EQ(hxal_config_ad_lookup("SN5"), 3);
}

TEST_F(Config_Parser, stops_at_128_adapters)
{
    for (int i = 0; i < 129; ++i)
        hxal_config_parse(("adapter-SN" + std::to_string(i) + "-power = 1;").c_str());
    hxal_config_ad_add("SN200");
    EXPECT_EQ(hxal_config_ad_get_num(), 128);
    EXPECT_EQ(hxal_config_ad_lookup("SN127"), 127);
    EXPECT_EQ(hxal_config_ad_lookup("SN128") & hxal_config_ad_lookup("SN200"), -1);
}

TEST_F(Config_Parser, gives_a_key_without_instance_to_the_entries_so_far)
{
    parse({"port-speed = 2;"});
    EXPECT_FALSE(has(ioc(0).flags, HXAL_CONFIG_PORT_SPEED));
    parse({"hxa0-port-wwn = 10:00:00:05:1e:10:00:00", "hxa5-port-wwn = 10:00:00:05:1e:10:00:01", "hxn1-port-mac = 00:05",
           "adapter-SN1-name = x", "port-speed = 4;", "port-topology = loop", "power = 2"});
    EXPECT_TRUE(has(hxal_config_get()->config_all, HXAL_CONFIG_PORT_SPEED));
    for (int idx : {0, 1}) // as many as have a WWN, from 0 on
        EXPECT_EQ(ioc(idx).speed, 4u) << idx;
    EXPECT_EQ(ioc(2).speed + ioc(5).speed, 0u);
    EXPECT_EQ(adapter(0).power, 2u);
    EXPECT_EQ(adapter(1).power, 0u);
    parse({"port-topology = ring", "port-name = x"});
    EXPECT_TRUE(has(hxal_config_get()->config_all, HXAL_CONFIG_PORT_TOPOLOGY));
    EXPECT_FALSE(has(ioc(0).flags, HXAL_CONFIG_PORT_TOPOLOGY));
    EXPECT_STREQ(ioc(1).name, "x");
    EXPECT_STREQ(ioc(1).ethname, "");
}

TEST_F(Config_Parser, keeps_virtual_ports_by_their_wwn)
{
    parse(
        {"hxa1-vport-4 = 10:00:AB, n, first, r, 1", "hxa1-vport-0 = x, n, second, r", "hxa1-vport-5 = 10:0:ab, m, third, s, 2"});
    hxal_config_set_vportdata(1, "y,n,fourth,r,70000");
    hxal_config_set_vportdata(1, "x,n,fifth,r,3");
    hxal_config_set_vportdata(128, "z,n,sixth,r,3");
    EXPECT_THAT(settings(), ElementsAre("hxa1-vport-5 = \"10:0:ab,m,third,s,2\";", "hxa1-vport-0 = \"x,n,fifth,r,3\";",
                                        "hxa1-vport-1 = \"y,n,fourth,r,0\";"));
    EXPECT_EQ(ioc(1).vpcount, 3);
    for (int i = 0; i < 300; ++i)
        hxal_config_set_vportdata(2, ("10:" + std::to_string(i / 10) + ":" + std::to_string(i % 10) + ",,,,").c_str());
    EXPECT_EQ(ioc(2).vpcount, 255);
    EXPECT_EQ(ioc(3).vpcount, 0);
}

TEST_F(Config_Parser, sets_single_values)
{
    hxal_config_set_data(HXAL_CONFIG_AD_SERIAL, 127, "SN127");
    hxal_config_set_data(HXAL_CONFIG_AD_NAME, 127, std::string(200, 'n').c_str());
    hxal_config_set_data(HXAL_CONFIG_PORT_WWN, 127, std::string(40, '1').c_str());
    for (const auto& [code, idx] : {std::pair{7, -1}, {7, 128}, {1, -1}, {0, 128}, {-1, 0}, {18, 0}, {24, 0}, {34, 0}, {99, 0}})
        hxal_config_set_data(code, idx, "8");
    hxal_config_set_data(7, 0, nullptr);
    EXPECT_THAT(settings(), ElementsAre("adapter-SN127-name = \"" + std::string(127, 'n') + "\";",
                                        "hxa127-port-wwn = \"" + std::string(31, '1') + "\";"));
}

TEST_F(Config_Parser, reads_a_file_by_lines_of_511_characters)
{
    const std::string comment = "#" + std::string(510, 'x');
    load(comment + "hxa1-port-speed = 4;\n"                                        // the tail of a comment is a line
         + "hxa2-port-speed = 8; # " + std::string(600, ' ') + "\n"                // cut within: no number at its end
         + "#hxa3-port-speed = 8;\n" + std::string("hxa4-port-speed = 8\0;\n", 22) // a NUL ends the text
         + std::string("\0hxa5-port-speed = 8;\n", 22)                             // and may be all of it
         + " #hxa6-port-speed = 8;\nhxa7-port-speed = 2");
    EXPECT_THAT(settings(), ElementsAre("hxa1-port-speed = 4;", "hxa2-port-speed = 0;", "hxa4-port-speed = 8;",
                                        "hxa6-port-speed = 8;", "hxa7-port-speed = 2;"));
}

TEST_F(Config_Parser, leaves_the_model_alone_when_there_is_no_file_to_read)
{
    parse({"hxa1-port-speed = 4;"});
    ASSERT_EQ(::mkfifo(path("fifo").c_str(), 0600), 0);
    for (const std::string& what : {path("missing"), path("."), path("fifo"), std::string("/dev/zero"), std::string()})
        EXPECT_EQ(hxal_config_load(what.c_str()), HXA_STATUS_OK) << what;
    EXPECT_EQ(hxal_config_load(nullptr), HXA_STATUS_OK);
    EXPECT_THAT(settings(), ElementsAre("hxa1-port-speed = 4;"));
}

TEST_F(Config_Parser, ends_in_a_file_that_grows_and_in_one_of_any_size)
{
    const std::string growing = file("growing", std::string(100000, '\n'));
    std::jthread writer(
        [&](const std::stop_token& stop)
        {
            std::ofstream stream(growing, std::ios::app);
            while (!stop.stop_requested())
                stream << std::string(4096, '\n') << std::flush;
        });
    EXPECT_EQ(hxal_config_load(growing.c_str()), HXA_STATUS_OK);
    writer.request_stop();
    writer.join();

    const std::string huge = file("huge", "hxa1-port-speed = 4;\n");
    std::filesystem::resize_file(huge, std::uintmax_t{1} << 40);
    EXPECT_EQ(hxal_config_load(huge.c_str()), HXA_STATUS_OK);
    EXPECT_THAT(settings(), ElementsAre("hxa1-port-speed = 4;"));
}

} // namespace
