// Events: who can fetch which of them, when a node is readable, and what raises them.
#include "sim/scenario/event_words.h"
#include "tests/sim/simulated_host.h"

#include <poll.h>
#include <sys/mman.h>

#include <functional>
#include <stdexcept>

namespace
{

using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;

constexpr const char* host_with_targets = R"({"adapters": [
    {"kind": "cna", "ports": [{"remote_ports": [{}, {"function": "initiator"}], "virtual_ports": [{}]}]},
    {"kind": "fc-hba", "ports": [{}]}]})";

std::string word_of(std::span<const hxasim::Choice> words, std::uint32_t value)
{
    for (const auto& choice : words)
        if (choice.value == value)
            return std::string(choice.word);
    return std::to_string(value);
}

std::string words_of(const hxa_aen_entry_t& event)
{
    return word_of(hxasim::event_category_words, event.aen_category) + " " +
           word_of(hxasim::event_words(event.aen_category), event.aen_type);
}

// A fetch as it is sent.
struct Fetch
{
    int instance = 0;
    int room = 64;
    std::uint32_t application = hxa_aen_app_cim;

    // Fills in the head and leaves the rest of the record alone. 0 or the errno.
    int send_in(const Open_File& node, hxal_ioctl_aen_t& record) const
    {
        record.hxad_num = instance;
        record.aen_count = room;
        record.app_id = application;
        record.status = HXA_STATUS_OK;
        record.block = 0;
        return send(*node, "IOCMD_AEN_GET", 'C', record);
    }
};

class Events : public Raw_Host
{
protected:
    Events() : Raw_Host("cna") {}

    static void sync(const Open_File& node, char group, std::uint32_t application)
    {
        hxa_ioctl_aen_t record{};
        record.app_id = application;
        EXPECT_EQ(send(*node, "IOCMD_AEN_SYNC", group, record), 0);
    }

    static std::vector<hxa_aen_entry_t> fetch(const Open_File& node, int instance, std::uint32_t application, int room = 64)
    {
        hxal_ioctl_aen_t record{};
        EXPECT_EQ((Fetch{.instance = instance, .room = room, .application = application}.send_in(node, record)), 0);
        EXPECT_EQ(record.status, HXA_STATUS_OK);
        EXPECT_LE(record.aen_count, room);
        return {record.aen_list, record.aen_list + record.aen_count};
    }

    static std::vector<int> numbers(const Open_File& node, int instance, std::uint32_t application, int room = 64)
    {
        sync(node, 'C', application);
        std::vector<int> numbers;
        for (const auto& event : fetch(node, instance, application, room))
            numbers.push_back(event.seq_num);
        return numbers;
    }

    static std::vector<std::string> words(const Open_File& node, int instance)
    {
        std::vector<std::string> words;
        for (const auto& event : fetch(node, instance, hxa_aen_app_cim))
            words.push_back(words_of(event));
        return words;
    }

    static bool readable(const Open_File& node)
    {
        pollfd waiting{.fd = *node, .events = POLLIN, .revents = 0};
        return poll(&waiting, 1, 0) == 1;
    }

    static void raise(int instance, int count = 1, const char* path = "/dev/hxa")
    {
        for (; count > 0; --count)
            hxasim::raise_event({.node = path, .instance = instance, .category = HXA_AEN_CAT_PORT, .type = 1});
    }
};

TEST_F(Events, are_read_once_by_every_application_in_their_order)
{
    Open_File hxa("/dev/hxa");
    raise(0, 3);
    raise(1);
    EXPECT_THAT(numbers(hxa, 0, 2, 2), ElementsAre(1, 2));
    EXPECT_THAT(numbers(hxa, 0, 2), ElementsAre(3));
    for (std::uint32_t application : {1U, 3U, 4U})
        EXPECT_THAT(numbers(hxa, 0, application), ElementsAre(1, 2, 3));
    EXPECT_THAT(numbers(hxa, 0, 0), IsEmpty()) << "nothing is queued for this one";
    EXPECT_THAT(numbers(hxa, 1, 2), ElementsAre(1));
}

TEST_F(Events, of_which_there_are_too_many_lose_the_oldest)
{
    Open_File hxa("/dev/hxa");
    raise(0, 10);
    EXPECT_EQ(numbers(hxa, 0, 1).size(), 10U);
    raise(0, 65'536);
    EXPECT_EQ(hxasim::lost_events(1), 0U);
    EXPECT_EQ(hxasim::lost_events(2), 10U);
    EXPECT_THAT(numbers(hxa, 0, 2, 2), ElementsAre(11, 12));
    EXPECT_THAT(numbers(hxa, 0, 1, 2), ElementsAre(11, 12));
}

TEST_F(Events, make_a_node_readable_while_the_application_has_any_to_fetch)
{
    Open_File hxa("/dev/hxa");
    Open_File hxn("/dev/hxn");
    Open_File other("/dev/hxa");
    raise(0);
    EXPECT_FALSE(readable(hxa)) << "no application";
    sync(hxa, 'C', hxa_aen_app_cim);
    sync(hxn, 'D', hxa_aen_app_cim);
    sync(other, 'C', hxa_aen_app_snia);
    EXPECT_TRUE(readable(hxa) && readable(other) && !readable(hxn));
    raise(1, 65);
    fetch(hxa, 0, hxa_aen_app_cim);
    fetch(hxa, 1, hxa_aen_app_cim);
    EXPECT_TRUE(readable(hxa)) << "one is left";
    fetch(hxa, 1, hxa_aen_app_cim);
    EXPECT_TRUE(!readable(hxa) && readable(other));
    raise(0, 1, "/dev/hxn");
    EXPECT_TRUE(!readable(hxa) && readable(hxn));
    sync(hxn, 'D', hxa_aen_app_tessik);
    EXPECT_FALSE(readable(hxn));
    hxasim::load("cna");
    EXPECT_FALSE(readable(other)) << "of an earlier host";
}

TEST_F(Events, are_written_to_the_caller_and_nothing_behind_them)
{
    Open_File hxa("/dev/hxa");
    sync(hxa, 'C', hxa_aen_app_cim);
    raise(0, 2);
    hxal_ioctl_aen_t record;
    std::memset(&record, 0xA5, sizeof(record));
    EXPECT_EQ(Fetch().send_in(hxa, record), 0) << "a driver reads the head only";
    EXPECT_EQ(record.aen_count, 2);
    EXPECT_EQ(record.aen_list[1].seq_num, 2);
    EXPECT_EQ(record.aen_list[2].aen_category, 0xA5A5A5A5U);
    const auto request = hxasim::take_requests().back();
    EXPECT_EQ(request.sent.size(), 20U);
    EXPECT_EQ(request.answered.size(), 20U + 2 * 68);
    EXPECT_EQ(std::memcmp(request.answered.data(), &record, request.answered.size()), 0);

    auto page = static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
    auto* memory = static_cast<char*>(mmap(nullptr, 2 * page, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0));
    ASSERT_EQ(mprotect(memory + page, page, PROT_NONE), 0);
    auto* head = reinterpret_cast<hxal_ioctl_aen_t*>(memory + page - 20);
    EXPECT_EQ(Fetch().send_in(hxa, *head), 0) << "a head is enough without events";
    EXPECT_EQ(head->aen_count, 0);
    munmap(memory, 2 * page);
}

// What one step on instance 0 of either node makes the drivers say there.
TEST_F(Events, follow_the_state_of_ports_and_IOCs)
{
    hxasim::load_text(host_with_targets);
    Open_File hxa("/dev/hxa");
    Open_File hxn("/dev/hxn");
    sync(hxa, 'C', hxa_aen_app_cim);
    sync(hxn, 'D', hxa_aen_app_cim);
    const auto order = [](const Open_File& node, const char* name, char group)
    {
        return [&node, name, group]
        {
            hxa_ioctl_gen_t record{};
            EXPECT_EQ(send(*node, name, group, record), 0);
            EXPECT_EQ(record.status, HXA_STATUS_OK);
        };
    };
    const auto remote = [&](const char* name)
    {
        return [&hxa, name]
        {
            hxa_ioctl_rport_t record{};
            record.pwwn = 0x00'00'10'1E'05'00'00'10;
            record.rpwwn = 0x00'00'00'1F'05'00'00'21;
            EXPECT_EQ(send(*hxa, name, '\xB2', record), 0);
            EXPECT_EQ(record.status, HXA_STATUS_OK);
        };
    };
    const std::vector<std::string> offline = {"port offline",  "lport offline", "rport offline",
                                              "itnim offline", "rport offline", "lport offline"};
    const std::vector<std::string> online = {"port online",  "lport online", "rport online",
                                             "itnim online", "rport online", "lport online"};
    const auto with = [](const char* first, std::vector<std::string> rest)
    {
        rest.insert(rest.begin(), first);
        return rest;
    };
    const struct
    {
        const char* step;
        std::function<void()> take;
        std::vector<std::string> on_hxa, on_hxn;
    } steps[] = {
        {"port disable", order(hxa, "IOCMD_PORT_DISABLE", 'C'), with("port disable", offline), {}},
        {"port enable", order(hxa, "IOCMD_PORT_ENABLE", 'C'), with("port enable", online), {}},
        {"Ethernet disable", order(hxn, "IOCMD_PORT_DISABLE", 'D'), {}, {"ethport disable", "ethport linkdown"}},
        {"Ethernet enable", order(hxn, "IOCMD_PORT_ENABLE", 'D'), {}, {"ethport enable", "ethport linkup"}},
        {"IOC disable", order(hxa, "IOCMD_IOC_DISABLE", 'C'), with("ioc disable", offline), {}},
        {"IOC enable", order(hxa, "IOCMD_IOC_ENABLE", 'C'), with("ioc enable", online), {}},
        {"remote port removed", remote("IOCMD_RPORT_REMOVE"), {"rport offline", "itnim offline"}, {}},
        {"remote port added", remote("IOCMD_RPORT_ADD"), {"rport online", "itnim online"}, {}},
        {"link down", [] { hxasim::set_link(0, 0, false); }, offline, {"ethport linkdown"}},
        {"port disable", order(hxa, "IOCMD_PORT_DISABLE", 'C'), {"port disable"}, {}},
        {"port enable", order(hxa, "IOCMD_PORT_ENABLE", 'C'), {"port enable"}, {}},
        {"link up", [] { hxasim::set_link(0, 0, true); }, online, {"ethport linkup"}},
        {"module out", [] { hxasim::set_sfp(0, 0, false); }, with("port sfp-remove", offline), {"ethport linkdown"}},
        {"module in", [] { hxasim::set_sfp(0, 0, true); }, with("port sfp-insert", online), {"ethport linkup"}},
        {"the other card out", [] { hxasim::unplug(1); }, {"adapter remove"}, {}},
        {"the other card in", [] { hxasim::plug(1); }, {"adapter add"}, {}},
    };
    for (const auto& [step, take, on_hxa, on_hxn] : steps)
    {
        take();
        EXPECT_THAT(words(hxa, 0), ElementsAreArray(on_hxa)) << step;
        EXPECT_THAT(words(hxn, 0), ElementsAreArray(on_hxn)) << step;
    }
}

TEST_F(Events, of_a_card_that_is_pulled_can_still_be_fetched)
{
    Open_File hxa("/dev/hxa");
    sync(hxa, 'C', hxa_aen_app_cim);
    hxasim::unplug(0);
    EXPECT_EQ(instances(hxa, 'C'), std::pair(0U, std::string(64, '0')));
    hxa_ioctl_port_attr_t record{};
    EXPECT_EQ(send(*hxa, "IOCMD_PORT_GET_ATTR", 'C', record), ENODEV);
    EXPECT_THAT(words(hxa, 0), ElementsAre("adapter remove")) << "what it said can still be fetched";
    EXPECT_THROW(hxasim::unplug(0), std::runtime_error);
    hxasim::plug(0);
    EXPECT_EQ(instances(hxa, 'C').first, 2U);
    EXPECT_THAT(words(hxa, 0), ElementsAre("adapter add"));
    EXPECT_THROW(hxasim::set_link(0, 2, true), std::runtime_error);
}

TEST_F(Events, of_a_card_that_its_application_does_not_know_make_no_node_readable)
{
    hxasim::load_text(R"({"adapters": [{"kind": "fc-hba"}, {"kind": "fc-hba", "plugged": false}]})");
    Open_File hxa("/dev/hxa");
    sync(hxa, 'C', hxa_aen_app_cim);
    EXPECT_EQ(instances(hxa, 'C'), std::pair(2U, "03" + std::string(62, '0')));
    hxasim::plug(1);
    EXPECT_TRUE(readable(hxa));
    EXPECT_THAT(words(hxa, 0), ElementsAre("adapter add")) << "told by a card that it knows";
    raise(2);
    EXPECT_FALSE(readable(hxa));
    sync(hxa, 'C', hxa_aen_app_cim);
    EXPECT_TRUE(readable(hxa));
}

} // namespace
