// Starting, stopping, powering and naming IOCs and adapters: the requests and pauses, the answers, and what is recorded.
#include "config_model.h"
#include "tests/hxal/library_fixture.h"

#include <cerrno>

namespace
{

using namespace std::chrono_literals;

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;

class Control : public Library_Test
{
protected:
    Control() { empty_model(); }

    // A CNA: FC IOCs with indexes 0 and 1, Ethernet IOCs 2 and 3.
    void plug_cna(int settle = 0, const std::string& state = "operational")
    {
        const std::string port = R"({"ioc_settle": )" + std::to_string(settle) + R"(, "ioc_state": ")" + state + R"("})";
        scan(R"({"adapters": [{"kind": "cna", "serial": "B1", "name": "blue", "ports": [)" + port + ", " + port + "]}]}");
        cna = hxal_adapter_open_idx(1);
    }

    // Requests that change something.
    static std::vector<std::string> changes()
    {
        auto texts = requests();
        std::erase_if(texts, [](const std::string& text) { return text.starts_with("IOCMD_IOC_GET_ATTR"); });
        return texts;
    }

    hxal_adapter_t* cna = nullptr;
};

TEST_F(Control, of_an_ioc_waits_a_second_before_each_look_at_its_state)
{
    struct Case
    {
        const char* what;
        int settle;
        hxasim::Fault fault;
        std::size_t looks;
        hxa_status_t status;
    };
    const Case cases[] = {
        {"at once", 0, {}, 1, HXA_STATUS_OK},
        {"after two looks", 2, {}, 3, HXA_STATUS_OK},
        {"at the last look", 19, {}, 20, HXA_STATUS_OK},
        {"too late", 20, {}, 20, HXA_STATUS_FAILED},
        {"after looks that failed", 0, {.command = "IOCMD_IOC_GET_ATTR", .error = EIO, .times = 4}, 5, HXA_STATUS_OK},
        {"refused", 0, {.status = 61}, 0, HXA_STATUS_IOC_NON_OP},
        {"failed", 0, {.error = ENXIO}, 0, HXA_STATUS_ENXIO},
    };
    struct Change
    {
        hxa_status_t (*function)(const hxal_t*);
        const char* before;
        uint32_t code;
    };
    const Change changes[] = {{hxal_ioc_enable, "disabled", 0xC0084403}, {hxal_ioc_disable, "operational", 0xC0084404}};
    for (const Change& change : changes)
        for (const Case& each : cases)
        {
            SCOPED_TRACE(std::string(each.what) + ", before " + change.before);
            plug_cna(each.settle, change.before);
            if (each.fault.error != 0 || each.fault.status != 0)
                hxasim::inject(each.fault);
            testing::internal::CaptureStdout();
            EXPECT_EQ(change.function(hxal_ioc_open_idx(3)), each.status);
            testing::internal::GetCapturedStdout();

            const auto sent = hxasim::take_requests();
            ASSERT_EQ(sent.size(), 1 + each.looks);
            EXPECT_EQ(sent[0].command, change.code);
            EXPECT_EQ(sent[0].instance, 1);
            EXPECT_EQ(sent[0].slept, 0s);
            for (std::size_t look = 1; look <= each.looks; ++look)
            {
                EXPECT_EQ(sent[look].name, "IOCMD_IOC_GET_ATTR");
                EXPECT_EQ(sent[look].slept, 1s);
            }
        }
    EXPECT_EQ(hxal_ioc_enable(nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_ioc_disable(nullptr), HXA_STATUS_EINVAL);
}

TEST_F(Control, of_an_adapter_reaches_every_ioc_port_by_port)
{
    const auto each_ioc = [](const std::string& command)
    { return ElementsAre(command + " /dev/hxa 0", command + " /dev/hxn 0", command + " /dev/hxa 1", command + " /dev/hxn 1"); };
    plug_cna();
    EXPECT_EQ(hxal_adapter_disable(1), HXA_STATUS_OK);
    EXPECT_THAT(changes(), each_ioc("IOCMD_IOC_DISABLE"));
    EXPECT_EQ(hxal_adapter_is_disabled(1), HXA_TRUE);
    EXPECT_EQ(hxal_adapter_disable(1), HXA_STATUS_IOC_DISABLED);
    hxasim::take_requests();
    EXPECT_EQ(hxal_adapter_enable(1), HXA_STATUS_OK);
    EXPECT_THAT(changes(), each_ioc("IOCMD_IOC_ENABLE"));
    EXPECT_EQ(hxal_adapter_is_enabled(1), HXA_TRUE);
    hxasim::take_requests();
    EXPECT_EQ(hxal_adapter_enable(1), HXA_STATUS_AD_IS_ENABLE);
    EXPECT_THAT(commands(), ElementsAre("IOCMD_IOC_GET_ATTR", "IOCMD_IOC_GET_ATTR", "IOCMD_IOC_GET_ATTR", "IOCMD_IOC_GET_ATTR"));
    for (int ad : {-1, 0, 2})
    {
        EXPECT_EQ(hxal_adapter_enable(ad), HXA_STATUS_FAILED);
        EXPECT_EQ(hxal_adapter_disable(ad), HXA_STATUS_FAILED);
    }
}

TEST_F(Control, of_an_adapter_answers_what_failed_the_last)
{
    plug_cna(0, "disabled");
    hxal_ioc_enable(hxal_ioc_open_idx(0)); // answers 59 from now on, which is no failure
    answer("IOCMD_IOC_ENABLE", 61, "/dev/hxn", 0);
    answer("IOCMD_IOC_ENABLE", 56, "/dev/hxa", 1);
    EXPECT_EQ(hxal_adapter_enable(1), HXA_STATUS_IOC_FAILURE);
    answer("IOCMD_IOC_DISABLE", 61, "/dev/hxa", 0);
    answer("IOCMD_IOC_DISABLE", 13, "/dev/hxn", 0);
    EXPECT_EQ(hxal_adapter_disable(1), HXA_STATUS_IOC_DISABLED) << "the second FC IOC never came up";

    plug_cna(); // all are enabled, but the first one cannot tell
    hxasim::inject({.command = "IOCMD_IOC_GET_ATTR", .error = EIO, .times = 1});
    testing::internal::CaptureStdout();
    EXPECT_EQ(hxal_adapter_enable(1), HXA_STATUS_AD_IS_ENABLE);
    testing::internal::GetCapturedStdout();
    EXPECT_EQ(changes().size(), 4u);
}

TEST_F(Control, of_power_asks_until_an_ioc_accepts_and_records_it_then)
{
    plug_cna();
    answer("IOCMD_IOC_SET_POWER", 26, "/dev/hxa", 0);
    EXPECT_EQ(hxal_adapter_set_power(cna, HXA_PM_DS_D2), HXA_STATUS_OK);
    EXPECT_THAT(changes(), ElementsAre("IOCMD_IOC_SET_POWER /dev/hxa 0", "IOCMD_IOC_SET_POWER /dev/hxn 0"));
    EXPECT_THAT(settings(), Contains("adapter-B1-power = 2;"));

    answer("IOCMD_IOC_SET_POWER", 13, "/dev/hxn", 1);
    hxasim::inject({.command = "IOCMD_IOC_SET_POWER", .error = EIO});
    EXPECT_EQ(hxal_adapter_set_power(cna, HXA_PM_DS_D3), HXA_STATUS_DEVBUSY);
    EXPECT_EQ(changes().size(), 4u);
    EXPECT_THAT(settings(), Contains("adapter-B1-power = 2;"));
    EXPECT_EQ(hxal_adapter_set_power(nullptr, HXA_PM_DS_D0), HXA_STATUS_EINVAL);
    hxal_adapter_t empty{};
    EXPECT_EQ(hxal_adapter_set_power(&empty, HXA_PM_DS_D0), HXA_STATUS_FAILED);
}

TEST_F(Control, of_a_name_tells_both_drivers)
{
    struct Case
    {
        const char* what;
        unsigned ad;
        hxasim::Fault fault;
        std::size_t requests;
        hxa_status_t last_error;
    };
    const char* const command = "IOCMD_IOC_SET_ADAPTER_NAME";
    const Case cases[] = {
        {"accepted", 1, {}, 2, HXA_STATUS_OK},
        {"no adapter 0", 0, {}, 0, HXA_STATUS_NO_ADAPTER},
        {"no adapter 2", 2, {}, 0, HXA_STATUS_NO_ADAPTER},
        {"no adapter of any number", UINT_MAX, {}, 0, HXA_STATUS_NO_ADAPTER},
        {"first refuses", 1, {.command = command, .node = "/dev/hxa", .status = 63}, 1, HXA_STATUS_SAME_NAME},
        {"first fails", 1, {.command = command, .node = "/dev/hxa", .error = ENXIO}, 1, HXA_STATUS_FAILED},
        {"other refuses", 1, {.command = command, .node = "/dev/hxn", .status = 63}, 2, HXA_STATUS_SAME_NAME},
        {"other fails", 1, {.command = command, .node = "/dev/hxn", .error = ENXIO}, 2, HXA_STATUS_FAILED},
    };
    for (const Case& each : cases)
    {
        SCOPED_TRACE(each.what);
        plug_cna();
        if (!each.fault.command.empty())
            hxasim::inject(each.fault);
        hxal_set_last_error(HXA_STATUS_DIAG_BUSY);
        hxal_adapter_set_name(each.ad, "green");
        EXPECT_EQ(hxal_get_last_error(), each.last_error);
        EXPECT_EQ(commands().size(), each.requests);
        const bool named = each.last_error == HXA_STATUS_OK;
        EXPECT_STREQ(cna->name, named ? "green" : "blue");
        EXPECT_EQ(std::ranges::count(settings(), R"(adapter-B1-name = "green";)"), named ? 1 : 0);
        empty_model();
    }

    plug_cna();
    hxal_adapter_set_name(1, std::string(65, 'n').c_str());
    const auto sent = hxasim::take_requests();
    ASSERT_EQ(sent.size(), 2u);
    for (const auto& request : sent)
        EXPECT_EQ(std::string(request.sent.begin() + 8, request.sent.end()), std::string(64, 'n')) << request.node;
    EXPECT_EQ(cna->name, std::string(63, 'n'));
    EXPECT_STREQ(hxal_adapter_get_name(1), std::string(63, 'n').c_str());
    hxal_adapter_set_name(1, nullptr);
    EXPECT_EQ(hxal_get_last_error(), HXA_STATUS_EINVAL);
}

TEST_F(Control, of_a_name_reaches_the_fc_driver_from_an_adapter_whose_first_ioc_has_another_port)
{
    host(R"({"adapters": [{"kind": "cna", "name": "blue"}]})");
    distort("IOCMD_IOC_GET_ATTR", offsetof(hxa_ioctl_ioc_attr_t, attr) + offsetof(hxa_ioc_attr_t, port_id), {3}, 0);
    ASSERT_EQ(hxal_adapter_scan(), 1);
    hxasim::take_requests();
    hxal_adapter_set_name(1, "green");
    EXPECT_THAT(changes(), ElementsAre("IOCMD_IOC_SET_ADAPTER_NAME /dev/hxa 0", "IOCMD_IOC_SET_ADAPTER_NAME /dev/hxn 0"));
}

TEST_F(Control, of_cards_whose_serial_numbers_fill_their_field_keeps_them_apart)
{
    scan(R"({"adapters": [{"kind": "fc-hba", "serial": "A23456789012"}, {"kind": "fc-hba", "serial": "A23456789019"},
                          {"kind": "fc-hba", "serial": "A2345678901"}]})");
    for (const int ad : {1, 2, 3})
        hxal_adapter_set_name(static_cast<unsigned>(ad), std::to_string(ad).c_str());
    hxal_adapter_set_power(hxal_adapter_lookup("A23456789019"), HXA_PM_DS_D2);
    const auto lines = settings();
    EXPECT_THAT(std::vector(lines.begin(), lines.begin() + 4),
                ElementsAre(R"(adapter-A23456789012-name = "1";)", R"(adapter-A23456789019-name = "2";)",
                            R"(adapter-A2345678901-name = "3";)", "adapter-A23456789019-power = 2;"));
    EXPECT_TRUE(hxal_config_get_ad_name_exists(1, "1", "A23456789019"));

    char serials[2][12];
    hxal_adapter_get_serial_num(hxal_adapter_open_idx(1), serials[0]);
    hxal_adapter_get_serial_num(hxal_adapter_open_idx(3), serials[1]);
    EXPECT_EQ(std::string(serials[0], 12) + serials[1], "A23456789012A2345678901");
}

TEST_F(Control, begins_with_a_scan_that_lists_each_card_and_ioc_in_the_configuration_once)
{
    plug_cna();
    hxal_adapter_scan();
    EXPECT_EQ(hxal_config_ad_get_num(), 1);
    EXPECT_EQ(hxal_config_ad_lookup("B1"), 0);
    EXPECT_EQ(hxal_config_ioc_get_num(), 2);
    EXPECT_EQ(hxal_config_ioc_lookup(port_wwn(0, 1)), 1);
    EXPECT_EQ(hxal_config_ethioc_lookup(eth_mac(0, 1)), 1);
    EXPECT_THAT(settings(),
                ElementsAre(R"(hxa0-port-wwn = "10:00:00:05:1e:10:00:00";)", R"(hxa1-port-wwn = "10:00:00:05:1e:10:00:01";)",
                            R"(hxn0-port-mac = "00:05:1e:20:00:00";)", R"(hxn1-port-mac = "00:05:1e:20:00:01";)"));
}

} // namespace
