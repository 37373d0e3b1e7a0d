// The file as it is written, whole.
#include "config_fixture.h"
#include "tests/hxal/golden.h"

#include <numeric>

namespace
{

using testing::ElementsAre;

using Config_Writer = Config_Model;

TEST_F(Config_Writer, writes_what_nobody_has_each_instance_has_and_all_instances_have)
{
    for (const char* name : {"empty.conf", "instances.conf", "for_all.conf"})
    {
        empty_model();
        load(golden(name));
        EXPECT_EQ(written(), golden(name)) << name;
    }
    hxal_config_ad_update(nullptr);
    hxal_config_ioc_update(nullptr);
    vport_traverse(nullptr, 0);
}

TEST_F(Config_Writer, writes_per_instance_what_has_no_line_for_all)
{
    parse({"hxa0-port-wwn = 10:00", "hxa1-port-wwn = 10:01", "port-hardalpa = 0x1"});
    EXPECT_THAT(settings(), ElementsAre("hxa0-port-wwn = \"10:00\";", "hxa1-port-wwn = \"10:01\";", "hxa0-port-hardalpa = 0x1;",
                                        "hxa1-port-hardalpa = 0x1;"));
}

TEST_F(Config_Writer, writes_a_value_for_all_that_reached_no_entry_as_it_was_read)
{
    for (int again = 0; again < 2; ++again)
    {
        load(golden("config_for_all.txt"));
        const std::vector<std::string> lines = settings();
        EXPECT_EQ(
            std::accumulate(lines.begin(), lines.end(), std::string(), [](auto text, auto line) { return text + line + "\n"; }),
            golden("config_for_all.txt"));
        hxal_config_ioc_add(1); // as a scan does
        hxal_config_ad_add("SN1");
        std::vector<std::string> after = settings();
        std::erase(after, "hxa0-port-wwn = \"01:00:00:00:00:00:00:00\";");
        EXPECT_EQ(after, lines);
        empty_model();
    }
}

TEST_F(Config_Writer, keeps_a_text_on_its_line)
{
    hxal_config_set_data(HXAL_CONFIG_AD_SERIAL, 0, "S\nN");
    hxal_config_set_data(HXAL_CONFIG_AD_NAME, 0, "a\";\nqos = \"TRUE\";\x7F\x1B");
    hxal_config_set_data(HXAL_CONFIG_PORT_NAME, 0, "gr\xC3\xBC\xC3\x9F\tb");
    EXPECT_THAT(settings(),
                ElementsAre("adapter-S?N-name = \"a\";?qos = \"TRUE\";??\";", "hxa0-port-name = \"gr\xC3\xBC\xC3\x9F\tb\";"));
}

TEST_F(Config_Writer, writes_the_virtual_ports_of_one_entry)
{
    parse({"hxa1-vport-2 = a,b,c,d,1", "hxa2-vport-0 = e,f,g,h,2"});
    char text[64] = {};
    std::FILE* file = ::fmemopen(text, sizeof text, "w");
    for (int idx : {-1, 0, 2, 128})
        vport_traverse(file, idx);
    std::fclose(file);
    EXPECT_STREQ(text, "hxa2-vport-0 = \"e,f,g,h,2\";\n");
}

} // namespace
