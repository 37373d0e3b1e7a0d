// The file as it is written, whole.
#include "config_fixture.h"

#include <random>

namespace
{

using testing::ElementsAre;

class Config_Writer : public Config_Model
{
protected:
    static std::string golden(const std::string& name) { return content(std::string(CONFIG_FILES) + "/" + name); }
};

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

TEST_F(Config_Writer, leaves_out_a_value_without_word)
{
    parse({"auth-algo = md5", "auth-secretsource = LOCAL", "log-level = Error", "port-topology = loop"}); // reach no entry
    EXPECT_THAT(settings(), ElementsAre("port-topology = \"none\";", "log-level = \"None\";"));
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

// A model of arbitrary settings, made as a file could make it.
class Random_Model
{
public:
    explicit Random_Model(unsigned seed) : random(seed) {}

    void fill()
    {
        for (int adapters = below(5), i = 0; i <= adapters; ++i)
        {
            parse("adapter-" + text(12) + "-name = " + text(127));
            parse("adapter-" + text(11) + "-power = " + std::to_string(below(4)));
        }
        for (int iocs = below(8), i = 0; i <= iocs; ++i)
            parse("hxa" + std::to_string(below(128)) + "-port-wwn = " + wwn());
        for (int lines = below(400), i = 0; i < lines; ++i)
            parse(below(12) ? "hxa" + std::to_string(below(128)) + "-" + setting() : setting());
        for (int lines = below(20), i = 0; i < lines; ++i)
            parse("hxn" + std::to_string(below(128)) + (below(2) ? "-port-name = " + text(127) : "-port-mac = " + text(31)));
        for (int lines = below(20), i = 0; i < lines; ++i)
            parse("hxa" + std::to_string(below(8)) + "-vport-" + std::to_string(below(300)) + " = " + wwn() + "," + wwn() + "," +
                  (below(3) ? text(127) : "") + "," + text(15) + "," + std::to_string(below(65536)));
        if (below(2))
            parse("power = " + std::to_string(below(4)));
    }

private:
    static void parse(const std::string& line) { hxal_config_parse(line.c_str()); }

    int below(int end) { return std::uniform_int_distribution(0, end - 1)(random); }

    template <typename Items> const auto& one_of(const Items& items)
    {
        return items[static_cast<std::size_t>(below(static_cast<int>(std::size(items))))];
    }

    std::string text(int longest)
    {
        constexpr std::string_view letters = "bcefgijkmoqsuvwyzBCE0123456789_.:"; // no word that tells the kind of a line
        std::string made(static_cast<std::size_t>(1 + below(longest)), ' ');
        for (char& letter : made)
            letter = one_of(letters);
        return made;
    }

    std::string wwn() { return "10:00:00:05:1e:10:" + std::to_string(below(10)) + ":" + std::to_string(below(10)); }

    std::string setting()
    {
        struct Keys
        {
            std::vector<const char*> keys;
            std::vector<const char*> words; // none: a number
        };
        // clang-format off
        static const Keys kinds[] = {
            {{"port-speed", "port-maxfrsize", "vf-default", "pathtov", "qdepth", "delay", "latency", "auth-group",
              "ratelim-defspeed"}, {}},
            {{"port-trunk", "vf-list"}, {"", "0", "1, 15", "7,3"}},
            {{"port-hardalpa"}, {"0x1f", "EF"}},
            {{"port-enable", "ipfc-enable", "vf-enable", "qos", "ratelim", "persistent-binding"}, {"TRUE", "FALSE", "true"}},
            {{"auth-policy", "coalesce"}, {"on", "off"}},
            {{"port-topology"}, {"none", "p2p", "loop", "auto", "ring"}},
            {{"log-level"}, {"Critical", "Error", "Warning", "Info", "None"}},
            {{"auth-algo"}, {"md5", "sha1", "ms", "sm"}},
            {{"auth-secretsource"}, {"LOCAL", "RADIUS", "TACACS"}},
            {{"auth-encrypt"}, {"7", "1,22,333"}},
        };
        // clang-format on
        const Keys& kind = one_of(kinds);
        const std::string key = one_of(kind.keys);
        return key + " = " + (kind.words.empty() ? std::to_string(below(70000)) : one_of(kind.words));
    }

    std::mt19937 random;
};

TEST_F(Config_Writer, writes_the_same_bytes_of_what_was_read_from_them)
{
    for (unsigned seed = 0; seed < 200; ++seed)
    {
        empty_model();
        Random_Model(seed).fill();
        const std::string first = written();
        empty_model();
        load(first);
        ASSERT_EQ(written(), first) << seed;
    }
}

} // namespace
