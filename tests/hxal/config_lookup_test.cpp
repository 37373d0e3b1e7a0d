// Whose an entry of the configuration model is.
#include "config_fixture.h"
#include "tests/hxal/library_fixture.h"

namespace
{

using Config_Lookup = Config_Model;

TEST_F(Config_Lookup, finds_and_adds_by_wwn_and_by_mac)
{
    EXPECT_EQ(hxal_config_ioc_lookup(0), -1) << "unused entries have an empty text, which converts to 0";
    EXPECT_EQ(hxal_config_ethioc_lookup({}), -1);
    parse({"hxa1-port-wwn = 10:00:00:05:1E:10:0:1", "hxa4-port-wwn = none", "hxn1-port-mac = 00:05:1e:20:00:01:77",
           "hxn2-port-mac = 00:05:1E:20:00:02"});
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(0, 1)), 1);
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(0, 0)), -1);
    EXPECT_EQ(hxal_config_ethioc_lookup(eth_mac(0, 1)), 1);
    EXPECT_EQ(hxal_config_ethioc_lookup(eth_mac(0, 2)), -1) << "a MAC is compared as text";

    hxal_config_ioc_add(port_wwn(0, 0));
    hxal_config_ethioc_add(eth_mac(0, 0)); // shares entry 0
    EXPECT_STREQ(ioc(0).pwwn, "10:00:00:05:1e:10:00:00");
    EXPECT_STREQ(ioc(0).mac, "00:05:1e:20:00:00");
    hxal_config_ioc_add(port_wwn(0, 2));
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(0, 2)), 2);
    EXPECT_EQ(hxal_config_ioc_get_num(), 4);

    hxal_config_ioc_pwwn(1, port_wwn(7, 7));
    hxal_config_ioc_pwwn(127, port_wwn(0, 1));
    hxal_config_ioc_pwwn(128, port_wwn(8, 8));
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(7, 7)), 1);
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(0, 1)), 127);
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(8, 8)), -1);

    for (uint8_t i = 0; i < 200; ++i)
    {
        hxal_config_ioc_add(port_wwn(9, i));
        hxal_config_ethioc_add(eth_mac(1, i));
    }
    EXPECT_EQ(hxal_config_ioc_get_num(), 128);
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(9, 123)), -1);
    EXPECT_EQ(hxal_config_ethioc_lookup(eth_mac(1, 199)), -1);
}

class Config_Names : public Library_Test
{
protected:
    Config_Names()
    {
        empty_model();
        host(one_cna);
        EXPECT_EQ(hxal_adapter_scan(), 1);
        serial = hxal_adapter_get_serial_num_by_idx(1);
        if (hxal_config_ad_lookup(serial) < 0)
            hxal_config_ad_add(serial);
        if (hxal_config_ioc_lookup(port_wwn(0, 1)) < 0)
            hxal_config_ioc_add(port_wwn(0, 1));
    }

    ~Config_Names() override { empty_model(); }

    const char* serial;
};

TEST_F(Config_Names, of_adapters_are_taken_by_another_only)
{
    hxal_config_ad_name(1, "Blue");
    hxal_config_ad_name(2, "Red");
    hxal_config_ad_name(1, nullptr);
    EXPECT_TRUE(hxal_config_get_ad_name_exists(1, "Blue", "another"));
    EXPECT_FALSE(hxal_config_get_ad_name_exists(1, "Blue", serial));
    for (const char* name : {"blue", "Blu", "Blue ", "Red", "", static_cast<const char*>(nullptr)})
        EXPECT_FALSE(hxal_config_get_ad_name_exists(1, name, "another"));
    EXPECT_FALSE(hxal_config_get_ad_name_exists(2, "Blue", "another"));
    hxal_config_ad_name(1, "");
    EXPECT_THAT(settings(), testing::Not(testing::Contains(testing::HasSubstr("-name"))));
}

TEST_F(Config_Names, of_ports_are_those_of_the_fc_side_where_there_is_one)
{
    hxal_config_ioc_name(hxal_adapter_get_fcioc(hxal_adapter_open_idx(1), 1), "fc 1");
    EXPECT_TRUE(hxal_config_get_port_name_exists(1, "fc 1", 1));
    EXPECT_FALSE(hxal_config_get_port_name_exists(1, "", 1));
    EXPECT_FALSE(hxal_config_get_port_name_exists(1, nullptr, 1));
    for (const auto& [ad, port] : {std::pair{1, 0}, {1, 2}, {1, -1}, {2, 1}, {0, 1}})
        EXPECT_FALSE(hxal_config_get_port_name_exists(ad, "fc 1", port)) << ad << port;
}

} // namespace
