#include "inventory/fchba_manager.h"
#include "inventory/host_text.h"
#include "inventory/provider_util.h"
#include "tests/inventory/inventory_fixture.h"

#include <netdb.h>

using namespace zmlr;
using testing::ElementsAre;

namespace
{

class Host : public Inventory_Test
{
protected:
    using Info = std::pair<int, std::string>; // the code and the text

    static Info info(int len = 255)
    {
        char buffer[256] = "untouched";
        const int code = ProviderUtil::getHostInfo(buffer, len);
        return {code, buffer};
    }
};

} // namespace

TEST_F(Host, info_tells_the_best_text_there_is)
{
    const std::string line = "INFO ProviderUtil: gethostbyname() FAILED. hostString will have hostname instead of ipAddress";
    const std::string no_domain = "WARN ProviderUtil: getdomainname() failed",
                      no_second_name = "WARN ProviderUtil: gethostname() failed";
    const std::string no_name = "INFO ProviderUtil: gethostname() FAILED. hostString will be filled with localhost";
    const std::string remark =
        "WARN CommonHelper: No host IP / Name  retrived in the function, So function fills localhost for host info.";
    const std::vector<std::string> loopback = {"127.0.0.1", "127.0.1.1"};
    const struct
    {
        const char* what;
        Fake_Host host;
        Info expected;
        std::vector<std::string> log;
    } cases[] = {
        // clang-format off
        {"an address",         {},                                               {0, "192.0.2.10"},   {}},
        {"a usable address",   {.addresses = {"127.0.1.1", "198.51.100.7", "192.0.2.10"}}, {0, "198.51.100.7"}, {}},
        {"no address",         {.addresses = {}},                                {2, "storage-host"}, {line}},
        {"loopback, no domain", {.addresses = loopback},                         {2, "storage-host"}, {line}},
        {"loopback, a domain", {.addresses = loopback, .domain = "example.com"}, {4, "storage-host.example.com"}, {}},
        {"no domain at all",   {.addresses = loopback, .domain = std::nullopt},  {2, "storage-host"}, {no_domain}},
        {"a name only once",   {.name_answers = 1, .addresses = loopback},       {2, "storage-host"}, {no_second_name}},
        {"no name",            {.name = std::nullopt},                           {3, "localhost"},    {no_name}},
        {"a list of 5000 bytes", {.memory_needed = 5000},                        {0, "192.0.2.10"},   {}},
        {"a list without end", {.memory_needed = std::size_t{1} << 30},          {2, "storage-host"}, {line}},
        // clang-format on
    };
    for (const auto& c : cases)
    {
        SCOPED_TRACE(c.what);
        fake_host = c.host;
        EXPECT_EQ(info(), c.expected);
        EXPECT_EQ(log(), c.log);

        fake_host = c.host;
        const Instance_Array systems = FCHBAManager::getFCHBAManager().getInstances(CLASSID_ComputerSystem);
        const std::string name = '"' + c.expected.second + '"';
        EXPECT_THAT(values_of(systems, "Name"), ElementsAre(name));
        EXPECT_THAT(values_of(systems, "OtherIdentifyingInfo"), ElementsAre("{ " + name + " }"));
        EXPECT_THAT(values_of(systems, "NameFormat"), ElementsAre(c.expected.first == 0 ? "\"IP\"" : "\"Other\""));
        EXPECT_THAT(values_of(systems, "IdentifyingDescriptions"),
                    ElementsAre(c.expected.first == 0 ? R"({ "Ipv4 Address" })" : R"({ "Fully Qualified Domain Name" })"));
        EXPECT_EQ(testing::Value(log(), testing::Contains(remark)), c.expected.first == 3);
    }
}

TEST_F(Host, info_is_bounded)
{
    EXPECT_EQ(info(5), (Info{0, "192."}));
    EXPECT_EQ(info(1), (Info{0, ""}));
    EXPECT_EQ(info(0), (Info{0, "untouched"}));
    EXPECT_EQ(info(-1), (Info{0, "untouched"}));

    fake_host = {.name = std::string(300, 'n'), .addresses = {"127.0.0.1"}, .domain = std::string(300, 'd')};
    EXPECT_EQ(info(), (Info{4, std::string(254, 'n')}));
    for (const auto& [id, size] : {std::pair{CLASSID_FCPort, 254U}, {CLASSID_EthernetPort, 63U}, {CLASSID_LANEndpoint, 63U}})
        EXPECT_THAT(values_of(FCHBAManager::getFCHBAManager().getInstances(id), "SystemName"),
                    testing::Each('"' + std::string(size, 'n') + '"'));
    fake_host.name = "localhost";
    EXPECT_EQ(info(10), (Info{2, "localhost"}));
}

TEST_F(Host, has_paths_files_and_a_node_name)
{
    EXPECT_STREQ(ProviderUtil::updateNamespacePath("ZEMLAR_FCPort.DeviceID=\"1\"").c_str(),
                 "//192.0.2.10/root/zemlar:ZEMLAR_FCPort.DeviceID=\"1\"");
    EXPECT_TRUE(ProviderUtil::IsFileExist("/"));
    EXPECT_FALSE(ProviderUtil::IsFileExist("/no/such/file"));
    EXPECT_STREQ(ProviderUtil::getClassName(static_cast<classId_t>(MAXCLASSID + 1)).c_str(), "INVALID CLASS");

    EXPECT_STREQ(ProviderUtil::getHostName().c_str(), "storage-host");
    fake_host.name.reset();
    EXPECT_STREQ(ProviderUtil::getHostName().c_str(), "localhost");
}
