// What a setter leaves in the file.
#include "config_fixture.h"
#include "tests/hxal/library_fixture.h"

#include <functional>
#include <thread>

namespace
{

using testing::ElementsAre;
using testing::IsEmpty;
using Lines = std::vector<std::string>;

class Config_Setters : public Config_Model
{
protected:
    // Entries 0 and 1 are those of these handles. Their WWN and MAC lines do not count.
    Config_Setters()
    {
        for (const uint8_t port : {uint8_t{0}, uint8_t{1}})
        {
            fc[port].ioc_type = HXA_IOC_TYPE_FC;
            fc[port].pwwn = port_wwn(0, port);
            eth[port].ioc_type = HXA_IOC_TYPE_LL;
            eth[port].mac = eth_mac(0, port);
        }
        start_anew();
    }

    void start_anew() const
    {
        empty_model();
        add_entries();
    }

    void add_entries() const
    {
        for (int port : {0, 1})
        {
            hxal_config_ioc_add(fc[port].pwwn);
            hxal_config_ethioc_add(eth[port].mac);
        }
    }

    static Lines lines()
    {
        Lines all = settings();
        std::erase_if(all, [](const std::string& line)
                      { return line.find("-port-wwn") != line.npos || line.find("-port-mac") != line.npos; });
        return all;
    }

    hxal_t fc[2] = {};
    hxal_t eth[2] = {};
};

using Set = std::function<void(const hxal_t*)>;

template <typename... Values> Set with(void (*setter)(const hxal_t*, Values...), std::type_identity_t<Values>... values)
{
    return [=](const hxal_t* ioc) { setter(ioc, values...); };
}

TEST_F(Config_Setters, keep_a_value_that_is_no_default)
{
    struct Row
    {
        Set set;
        const char* line;
        std::vector<Set> defaults; // that keep nothing
    };
    const auto yes = HXA_TRUE, no = HXA_FALSE;
    const auto dh768 = HXA_AUTH_GROUP_DH768;
    const auto no_algorithm = hxa_auth_algo_t{};
    // clang-format off
    const Row rows[] = {
        {with(hxal_config_ioc_name, "uplink"), "hxa1-port-name = \"uplink\";", {with(hxal_config_ioc_name, "")}},
        {with(hxal_config_log_level, 4), "hxa1-log-level = \"Info\";",
         {with(hxal_config_log_level, 0), with(hxal_config_log_level, 9)}},
        {with(hxal_config_pbind, yes), "hxa1-persistent-binding = \"TRUE\";", {with(hxal_config_pbind, no)}},
        {with(hxal_config_qos, yes), "hxa1-qos = \"TRUE\";", {with(hxal_config_qos, no)}},
        {with(hxal_config_ratelim, yes), "hxa1-ratelim = \"TRUE\";", {with(hxal_config_ratelim, no)}},
        {with(hxal_config_defspeed, HXA_PPORT_SPEED_4GBPS), "hxa1-ratelim-defspeed = 4;",
         {with(hxal_config_defspeed, HXA_PPORT_SPEED_1GBPS)}},
        {with(hxal_config_defspeed, HXA_PPORT_SPEED_AUTO), "hxa1-ratelim-defspeed = 0;", {}},
        {with(hxal_config_vf_mode, 1, yes), "hxa1-vf-enable = \"TRUE\"", {with(hxal_config_vf_mode, 1, no)}},
        {with(hxal_config_vf_mode, 0, no), "hxa1-vf-default = 0;", {}},
        {with(hxal_config_vf_list, 15, yes), "hxa1-vf-list = 15;", {with(hxal_config_vf_list, 15, no)}},
        {with(hxal_config_topology, HXA_PPORT_TOPOLOGY_LOOP), "hxa1-port-topology = \"loop\";",
         {with(hxal_config_topology, HXA_PPORT_TOPOLOGY_NONE)}},
        {with(hxal_config_speed, HXA_PPORT_SPEED_8GBPS), "hxa1-port-speed = 8;",
         {with(hxal_config_speed, HXA_PPORT_SPEED_AUTO)}},
        {with(hxal_config_alpa, 0xEF, yes), "hxa1-port-hardalpa = 0xef;", {with(hxal_config_alpa, 0xEF, no)}},
        {with(hxal_config_maxfrsz, 2048), "hxa1-port-maxfrsize = 2048;", {with(hxal_config_maxfrsz, 2112)}},
        {with(hxal_config_enable, no), "hxa1-port-enable = \"FALSE\";", {with(hxal_config_enable, yes)}},
        {with(hxal_config_ipfc_enable, no), "hxa1-ipfc-enable = \"FALSE\";", {with(hxal_config_ipfc_enable, yes)}},
        {with(hxal_config_trunk, 5, yes), "hxa1-port-trunk = 0, 2;", {with(hxal_config_trunk, 5, no)}},
        {with(hxal_config_fcpim, 30), "hxa1-pathtov = 30;", {with(hxal_config_fcpim, 0)}},
        {with(hxal_config_qdepth, 32), "hxa1-qdepth = 32;", {with(hxal_config_qdepth, 0)}},
        {with(hxal_config_auth_policy, yes), "hxa1-auth-policy = \"on\";", {with(hxal_config_auth_policy, no)}},
        {with(hxal_config_auth_algo, HXA_AUTH_ALGO_SM), "hxa1-auth-algo = \"sm\";", {with(hxal_config_auth_algo, no_algorithm)}},
        {with(hxal_config_auth_group, HXA_AUTH_GROUP_ALL), "hxa1-auth-group = 256;", {with(hxal_config_auth_group, dh768)}},
        {with(hxal_config_auth_secretsource, HXA_AUTH_SECSRC_TACACS), "hxa1-auth-secretsource = \"TACACS\";",
         {with(hxal_config_auth_secretsource, HXA_AUTH_SECSRC_LOCAL)}},
    };
    // clang-format on
    for (const Row& row : rows)
    {
        start_anew();
        row.set(&fc[1]);
        EXPECT_EQ(lines(), Lines{row.line});
        for (const Set& set_default : row.defaults)
        {
            set_default(&fc[1]);
            EXPECT_THAT(lines(), IsEmpty()) << row.line;
        }
    }
}

TEST_F(Config_Setters, keep_moderation_that_differs_from_the_drivers_defaults)
{
    const struct
    {
        hxa_boolean_t coalesce;
        uint16_t delay, latency;
        Lines lines;
    } rows[] = {
        {HXA_TRUE, 1125, 225, {}},
        {HXA_TRUE, 1125, 224, {"hxa0-delay = 1125;", "hxa0-latency = 224;"}},
        {HXA_TRUE, 0, 0, {"hxa0-delay = 0;", "hxa0-latency = 0;"}},
        {HXA_TRUE, 7, 8, {"hxa0-delay = 7;", "hxa0-latency = 8;"}},
        {HXA_FALSE, 0, 0, {"hxa0-coalesce = \"off\";"}},
        {HXA_FALSE, 9, 0, {"hxa0-coalesce = \"off\";", "hxa0-delay = 7;"}}, // off: the values of before stay
        {HXA_FALSE, 0, 9, {"hxa0-coalesce = \"off\";", "hxa0-latency = 8;"}},
        {HXA_FALSE, 1125, 225, {"hxa0-coalesce = \"off\";"}},
        {HXA_TRUE, 1125, 225, {}},
    };
    for (const auto& row : rows)
    {
        hxal_config_iocfc_intr(&fc[0], row.coalesce, row.delay, row.latency);
        EXPECT_EQ(lines(), row.lines) << &row - rows;
    }
}

TEST_F(Config_Setters, turn_a_setting_of_all_instances_into_one_of_each)
{
    struct Row
    {
        const char* for_all;
        Set set;
        Lines lines;
        bool comes_first = false; // before there is any entry
    };
    const uint32_t same[] = {1, 2}, other[] = {1, 3};
    const Lines speeds = {"hxa0-port-speed = 4;", "hxa1-port-speed = 8;"};
    // clang-format off
    const Row rows[] = {
        {"port-speed = 4;",         with(hxal_config_speed, HXA_PPORT_SPEED_4GBPS), {"port-speed = 4;"}},
        {"port-speed = 4;",         with(hxal_config_speed, HXA_PPORT_SPEED_8GBPS), speeds},
        {"port-speed = 4;",         with(hxal_config_speed, HXA_PPORT_SPEED_8GBPS), speeds, true},
        {"port-speed = 4;",         with(hxal_config_speed, HXA_PPORT_SPEED_AUTO),  {"hxa0-port-speed = 4;"}},
        {"qos = \"TRUE\";",         with(hxal_config_qos, HXA_FALSE),               {"hxa0-qos = \"TRUE\";"}},
        {"vf-list = 1, 2;",         with(hxal_config_vf_list, 2, HXA_FALSE), {"hxa0-vf-list = 1, 2;", "hxa1-vf-list = 1;"}},
        {"auth-encrypt = \"1,2\";", with(hxal_config_auth_secretstring, same, 2),   {"auth-encrypt = \"1,2\";"}},
        {"auth-encrypt = \"1,2\";", with(hxal_config_auth_secretstring, other, 2),
         {"hxa0-auth-encrypt = \"1,2\";", "hxa1-auth-encrypt = \"1,3\";"}},
        {"auth-encrypt = 1",        with(hxal_config_auth_secretstring, nullptr, 0), {"hxa0-auth-encrypt = \"1\";"}, true},
        {"delay = 7;",              with(hxal_config_iocfc_intr, HXA_FALSE, 9, 0),  {"delay = 7;", "hxa1-coalesce = \"off\";"}},
        {"port-enable = TRUE",      with(hxal_config_enable, HXA_FALSE),
         {"hxa0-port-enable = \"TRUE\";", "hxa1-port-enable = \"FALSE\";"}, true},
        {"port-enable = TRUE",      with(hxal_config_enable, HXA_TRUE),  {"port-enable = \"TRUE\";"}, true},
        {"port-enable = maybe",     with(hxal_config_enable, HXA_FALSE), {"hxa1-port-enable = \"FALSE\";"}, true},
        {"port-name = x",           with(hxal_config_ioc_name, "y"),
         {"hxa0-port-name = \"x\";", "hxa1-port-name = \"y\";"}, true},
    };
    // clang-format on
    for (const Row& row : rows)
    {
        empty_model();
        if (row.comes_first)
            parse({row.for_all});
        add_entries();
        if (!row.comes_first)
            parse({row.for_all});
        row.set(&fc[1]);
        EXPECT_EQ(lines(), row.lines) << &row - rows;
    }
    empty_model();
    parse({"power = 2"});
    hxal_config_ad_add("SN0");
    hxal_config_ad_add("SN1");
    hxal_config_ad_ps(1, HXA_PM_DS_D0);
    EXPECT_THAT(lines(), ElementsAre("adapter-SN0-power = 2;"));
}

TEST_F(Config_Setters, write_the_secret_in_whole_numbers)
{
    const std::vector<uint32_t> words(200, 4294967295u);
    hxal_config_auth_secretstring(&fc[0], words.data(), 200);
    std::string expected = "4294967295";
    for (int i = 1; i < 46; ++i) // 46 * 11 - 1 = 505
        expected += ",4294967295";
    EXPECT_EQ(ioc(0).authsstring, expected);
    const std::vector<uint32_t> digits(256, 7);
    hxal_config_auth_secretstring(&fc[0], digits.data(), 256);
    EXPECT_EQ(std::strlen(ioc(0).authsstring), 511u);
    hxal_config_auth_secretstring(&fc[0], digits.data(), 0);
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Config_Setters, find_ethernet_names_by_mac_and_adapters_by_entry)
{
    hxal_config_ioc_name(&eth[1], "eth");
    hxal_config_ad_add("SN0");
    hxal_config_ad_add("SN1");
    hxal_config_ad_ps(1, HXA_PM_DS_D3);
    hxal_config_ad_ps(-1, HXA_PM_DS_D3);
    hxal_config_ad_ps(128, HXA_PM_DS_D3);
    EXPECT_THAT(lines(), ElementsAre("adapter-SN1-power = 3;", "hxn1-port-name = \"eth\";"));
    hxal_config_ad_ps(1, HXA_PM_DS_D0);
    EXPECT_THAT(lines(), ElementsAre("hxn1-port-name = \"eth\";"));
    parse({"power = 2"});
    hxal_config_ad_ps(1, HXA_PM_DS_D1);
    EXPECT_THAT(lines(), ElementsAre("adapter-SN0-power = 2;", "adapter-SN1-power = 1;", "hxn1-port-name = \"eth\";"));
}

TEST_F(Config_Setters, keep_virtual_ports)
{
    hxa_port_cfg_t port = {};
    port.pwwn = port_wwn(1, 1);
    port.nwwn = node_wwn(1, 1);
    port.roles = HXA_PORT_ROLE_FCP_IM;
    std::memset(port.sym_name, 'x', sizeof port.sym_name); // without terminator
    hxal_config_vport_add(&fc[0], 3, &port);
    std::strcpy(port.sym_name, "second");
    port.pwwn = port_wwn(1, 2);
    hxal_config_vport_add(&fc[0], 0, &port);
    const std::string wwns[] = {"10:00:00:05:1e:10:01:01", "10:00:00:05:1e:10:01:02"};
    const std::string node = "20:00:00:05:1e:10:01:01";
    const std::string second = "hxa0-vport-1 = \"" + wwns[1] + "," + node + ",second,1,0\";";
    EXPECT_THAT(lines(),
                ElementsAre("hxa0-vport-0 = \"" + wwns[0] + "," + node + "," + std::string(127, 'x') + ",1,3\";", second));

    hxal_config_vport_del(&fc[0], port_wwn(1, 3));
    hxal_config_vport_del(&fc[0], port_wwn(1, 1));
    EXPECT_THAT(lines(), ElementsAre(second));
    hxal_config_vport_add(&fc[0], 9, &port); // replaced, under its number
    EXPECT_THAT(lines(), ElementsAre("hxa0-vport-1 = \"" + wwns[1] + "," + node + ",second,1,9\";"));
    hxal_config_vport_del(&fc[0], port_wwn(1, 2));
    EXPECT_EQ(ioc(0).vpcount, 0);
    EXPECT_FALSE(has(ioc(0).flags, HXAL_CONFIG_VPORT));
}

TEST_F(Config_Setters, do_nothing_without_an_entry)
{
    parse({"hxa5-port-wwn = none"}); // converts to 0, the WWN of every Ethernet IOC
    hxal_t unknown = {};
    unknown.ioc_type = HXA_IOC_TYPE_FC;
    unknown.pwwn = port_wwn(9, 9);
    hxal_t nobody = {};
    nobody.ioc_type = HXA_IOC_TYPE_FC;
    const hxa_port_cfg_t port = {};
    const hxal_t* const handles[] = {&unknown, &nobody, &eth[0], nullptr};
    for (const hxal_t* ioc : handles)
    {
        hxal_config_speed(ioc, HXA_PPORT_SPEED_8GBPS);
        hxal_config_enable(ioc, HXA_FALSE);
        hxal_config_iocfc_intr(ioc, HXA_FALSE, 1, 1);
        hxal_config_vf_mode(ioc, 7, HXA_TRUE);
        hxal_config_vf_list(ioc, 7, HXA_TRUE);
        hxal_config_vport_add(ioc, 1, &port);
        hxal_config_vport_del(ioc, 0);
        hxal_config_auth_secretstring(ioc, nullptr, 5);
        if (ioc != &eth[0])
            hxal_config_ioc_name(ioc, "x");
    }
    hxal_config_vf_list(&fc[0], 16, HXA_TRUE); // the list ends at 15
    hxal_config_vport_add(&fc[0], 1, nullptr);
    hxal_config_ioc_name(&fc[0], nullptr);
    hxal_config_ad_name(1, "x");
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Config_Setters, may_be_called_on_any_thread)
{
    std::vector<std::jthread> threads;
    for (int port : {0, 1})
        threads.emplace_back(
            [this, port]
            {
                for (uint16_t depth = 1; depth <= 1000; ++depth)
                {
                    hxal_config_qdepth(&fc[port], depth);
                    hxal_config_enable(&fc[port], depth % 2 ? HXA_FALSE : HXA_TRUE);
                    hxal_config_vport_del(&fc[port], 0);
                }
            });
    for (int i = 0; i < 5; ++i)
        settings();
    threads.clear();
    EXPECT_THAT(lines(), ElementsAre("hxa0-qdepth = 1000;", "hxa1-qdepth = 1000;"));
}

} // namespace
