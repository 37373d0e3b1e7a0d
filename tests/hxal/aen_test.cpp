// Which registrations an event is for, and in which form they are told of it.
#include "hxal/internal/aen_kinds.h"
#include "tests/hxal/aen_listeners.h"

#include <algorithm>
#include <atomic>
#include <set>
#include <thread>

namespace
{

using testing::ElementsAre;

constexpr wwn_t a_wwn = 0x1111;
constexpr wwn_t b_wwn = 0x2222;

template <typename Data> hxa_aen_entry_t event(uint32_t category, uint32_t type, int instance, const Data& data)
{
    hxa_aen_entry_t entry{};
    entry.aen_category = category;
    entry.aen_type = type;
    entry.hxad_num = instance;
    std::memcpy(&entry.aen_data, &data, sizeof data);
    return entry;
}

// clang-format off
hxa_aen_entry_t adapter_event(uint32_t type, const char* serial, wwn_t pwwn = 0)
{
    hxa_adapter_aen_data_t data{};
    std::memcpy(data.serial_num, serial, std::min(std::strlen(serial), sizeof data.serial_num));
    data.pwwn = pwwn;
    return event(HXA_AEN_CAT_ADAPTER, type, 99, data);
}
auto port_data(wwn_t pwwn, mac_t mac) { hxa_port_aen_data_t d{}; d.pwwn = pwwn; d.mac = mac; return d; }
auto lport_data(wwn_t lpwwn) { hxa_lport_aen_data_t d{}; d.lpwwn = lpwwn; return d; }
auto rport_data(wwn_t lpwwn) { hxa_rport_aen_data_t d{}; d.lpwwn = lpwwn; return d; }
auto itnim_data(wwn_t lpwwn, wwn_t rpwwn) { hxa_itnim_aen_data_t d{}; d.lpwwn = lpwwn; d.rpwwn = rpwwn; return d; }
auto audit_data(wwn_t pwwn) { hxa_audit_aen_data_t d{}; d.pwwn = pwwn; return d; }
auto ethport_data(mac_t mac) { hxa_ethport_aen_data_t d{}; d.mac = mac; return d; }

auto port_event(int inst, wwn_t pwwn, mac_t mac)
{ return event(HXA_AEN_CAT_PORT, HXA_PORT_AEN_ONLINE, inst, port_data(pwwn, mac)); }
auto lport_event(int inst, uint32_t type, wwn_t wwn) { return event(HXA_AEN_CAT_LPORT, type, inst, lport_data(wwn)); }
auto rport_event(int inst, wwn_t wwn) { return event(HXA_AEN_CAT_RPORT, HXA_RPORT_AEN_ONLINE, inst, rport_data(wwn)); }
auto itnim_event(int inst, wwn_t lpwwn, wwn_t rpwwn)
{ return event(HXA_AEN_CAT_ITNIM, HXA_ITNIM_AEN_ONLINE, inst, itnim_data(lpwwn, rpwwn)); }
auto audit_event(int inst, wwn_t pwwn) { return event(HXA_AEN_CAT_AUDIT, HXA_AUDIT_AEN_AUTH_ENABLE, inst, audit_data(pwwn)); }
auto ioc_event(int inst) { return event(HXA_AEN_CAT_IOC, HXA_IOC_AEN_ENABLE, inst, hxa_ioc_aen_data_t{}); }
auto ethport_event(int inst, mac_t mac) { return event(HXA_AEN_CAT_ETHPORT, HXA_ETHPORT_AEN_LINKUP, inst, ethport_data(mac)); }

TEST_F(Aen, reaches_the_registrations_that_match)
{
    const mac_t mac = eth_mac(0, 0);
    const mac_t other_mac = eth_mac(0, 1);
    const auto adapter_of = [](const hxal_adapter_t* card) { return [=](Listener& to) { return listen_adapter(to, card); }; };
    const auto port = [](const hxal_t* ioc, hxa_port_aen_data_t data)
    { return [=](Listener& to) { return listen_port(to, ioc, data); }; };
    const auto lport = [&](wwn_t lpwwn) { return [=, this](Listener& to) { return listen_lport(to, fc, lport_data(lpwwn)); }; };
    const auto rport = [&](wwn_t lpwwn) { return [=, this](Listener& to) { return listen_rport(to, fc, rport_data(lpwwn)); }; };
    const auto itnim = [&](wwn_t lpwwn, wwn_t rpwwn)
    { return [=, this](Listener& to) { return listen_itnim(to, fc, itnim_data(lpwwn, rpwwn)); }; };
    const auto audit = [&](wwn_t pwwn) { return [=, this](Listener& to) { return listen_audit(to, fc, audit_data(pwwn)); }; };
    const auto ioc = [](const hxal_t* object) { return [=](Listener& to) { return listen_ioc(to, object); }; };
    const auto ethport = [](const hxal_t* object) { return [=](Listener& to) { return listen_ethport(to, object); }; };

    const struct
    {
        std::function<hxa_status_t(Listener&)> registration;
        hxa_aen_entry_t event;
        bool heard;
    } cases[] = {
        {adapter_of(nullptr), adapter_event(HXA_ADAPTER_AEN_ADD, "anything"),          true},
        {adapter_of(nullptr), adapter_event(HXA_ADAPTER_AEN_REMOVE, "ZMC0000001"),     false},
        {adapter_of(adapter), adapter_event(HXA_ADAPTER_AEN_REMOVE, "ZMC0000001"),     true},
        {adapter_of(adapter), adapter_event(HXA_ADAPTER_AEN_ADD, "ZMC0000001"),        true},
        {adapter_of(adapter), adapter_event(HXA_ADAPTER_AEN_REMOVE, "ZMC0000002"),     false},
        {adapter_of(adapter), adapter_event(HXA_ADAPTER_AEN_REMOVE, "ZMC000000123456"), false},
        {port(fc, port_data(a_wwn, {})),   port_event(0, a_wwn, mac),                   true},
        {port(fc, port_data(a_wwn, mac)),  port_event(0, b_wwn, mac),                   false}, // only the WWN counts
        {port(fc, port_data(a_wwn, {})),   port_event(1, a_wwn, mac),                   false},
        {port(fc, port_data(0, {})),       port_event(0, 0, mac),                       false},
        {port(eth, port_data(a_wwn, mac)), port_event(0, b_wwn, mac),                   true},
        {port(eth, port_data(a_wwn, mac)), port_event(0, a_wwn, other_mac),             false}, // only the MAC counts
        {lport(a_wwn),          lport_event(0, HXA_LPORT_AEN_ONLINE, a_wwn),            true},
        {lport(a_wwn),          lport_event(0, HXA_LPORT_AEN_ONLINE, b_wwn),            false},
        {lport(a_wwn),          lport_event(1, HXA_LPORT_AEN_ONLINE, a_wwn),            false},
        {lport(a_wwn),          lport_event(0, HXA_LPORT_AEN_NEW, a_wwn),               false},
        {lport(0),              lport_event(0, HXA_LPORT_AEN_NEW, a_wwn),               true},
        {lport(0),              lport_event(1, HXA_LPORT_AEN_NEW, a_wwn),               false},
        {lport(0),              lport_event(0, HXA_LPORT_AEN_ONLINE, a_wwn),            false},
        {rport(a_wwn),          rport_event(0, a_wwn),                                  true},
        {rport(a_wwn),          rport_event(0, b_wwn),                                  false},
        {rport(a_wwn),          rport_event(1, a_wwn),                                  false},
        {itnim(a_wwn, b_wwn),   itnim_event(0, a_wwn, b_wwn),                           true},
        {itnim(a_wwn, b_wwn),   itnim_event(0, a_wwn, a_wwn),                           false},
        {itnim(a_wwn, b_wwn),   itnim_event(1, a_wwn, b_wwn),                           false},
        {itnim(a_wwn, 0),       itnim_event(0, a_wwn, b_wwn),                           true},
        {itnim(a_wwn, 0),       itnim_event(0, b_wwn, b_wwn),                           false},
        {audit(a_wwn),          audit_event(0, a_wwn),                                  true},
        {audit(a_wwn),          audit_event(0, b_wwn),                                  false},
        {audit(a_wwn),          audit_event(1, a_wwn),                                  false},
        {ioc(fc),               ioc_event(0),                                           true},
        {ioc(fc),               ioc_event(1),                                           false},
        {ioc(nullptr),          ioc_event(0),                                           false},
        {ethport(eth),          ethport_event(0, mac),                                  true},
        {ethport(eth),          ethport_event(0, other_mac),                            false},
        {ethport(eth),          ethport_event(1, mac),                                  false},
        {ioc(fc),               event(HXA_AEN_CAT_TIN, 1, 0, audit_data(a_wwn)),        false},
        {audit(a_wwn),          event(HXA_AEN_CAT_IPFC, 1, 0, audit_data(a_wwn)),       false},
        {audit(a_wwn),          event(HXA_AEN_MAX_CAT + 1, 1, 0, audit_data(a_wwn)),    false},
    };
    // clang-format on
    for (std::size_t i = 0; i < std::size(cases); ++i)
    {
        Listener listener(heard, "it");
        EXPECT_EQ(cases[i].registration(listener), HXA_STATUS_OK);
        for (int again = 0; again < 2; ++again) // the mark of the first delivery is gone
        {
            hxal::dispatch_event(cases[i].event);
            EXPECT_EQ(heard.take().size(), cases[i].heard ? 1U : 0U) << "case " << i;
        }
    }
}

TEST_F(Aen, hands_over_the_drivers_data_and_time)
{
    struct Told
    {
        uint32_t event;
        hxa_port_aen_data_t data;
        hxa_timeval_t time;
    } told{};
    hxa_port_aen_data_t data = port_data(a_wwn, eth_mac(0, 0));
    data.level = 3;
    hxal_port_aen_cbhandle_t* handle = nullptr;
    const auto callback = [](void* to, uint32_t event, const hxa_port_aen_data_t* from, hxa_timeval_t time) {
        *static_cast<Told*>(to) = {event, *from, time};
    };
    ASSERT_EQ(hxal_port_aen_register(fc, callback, &told, &data, &handle), HXA_STATUS_OK);
    auto entry = event(HXA_AEN_CAT_PORT, 12345, 0, data);
    entry.aen_tv = {.tv_sec = 7, .tv_usec = 8};
    hxal::dispatch_event(entry);
    EXPECT_EQ(told.event, 12345U);
    EXPECT_EQ(std::memcmp(&told.data, &data, sizeof data), 0);
    EXPECT_EQ(told.time.tv_sec, 7U);
    EXPECT_EQ(told.time.tv_usec, 8U);
    hxal_port_aen_unregister(handle);
}

TEST_F(Aen, calls_the_newest_registration_first_and_those_that_are_made_meanwhile)
{
    Listener first(heard, "first");
    Listener second(heard, "second");
    Listener third(heard, "third");
    Listener late(heard, "late");
    listen_ioc(first, fc);
    listen_ioc(second, fc);
    listen_ioc(third, fc);
    second.then = [&] { EXPECT_EQ(listen_ioc(late, fc), HXA_STATUS_OK); };
    hxal::dispatch_event(ioc_event(0));
    EXPECT_THAT(heard.take(), ElementsAre("third 3", "second 3", "late 3", "first 3"));
    second.then = [&] { EXPECT_EQ(first.end(), HXA_STATUS_OK); };
    late.then = [&] { EXPECT_EQ(late.end(), HXA_STATUS_OK); };
    hxal::dispatch_event(ioc_event(0));
    EXPECT_THAT(heard.take(), ElementsAre("late 3", "third 3", "second 3"));
    second.then = {};
    hxal::dispatch_event(ioc_event(0));
    EXPECT_THAT(heard.take(), ElementsAre("third 3", "second 3"));
}

TEST_F(Aen, calls_nobody_before_he_has_his_handle)
{
    struct Guest
    {
        hxal_ioc_aen_cbhandle_t* handle = nullptr;
        std::atomic<hxa_status_t> left = HXA_STATUS_PENDING;
    };
    const auto leave = [](void* to, uint32_t, const hxa_ioc_aen_data_t*, hxa_timeval_t)
    {
        auto& guest = *static_cast<Guest*>(to);
        guest.left = hxal_ioc_aen_unregister(guest.handle);
    };
    std::atomic<bool> stop = false;
    std::thread dispatcher(
        [&]
        {
            for (; !stop; std::this_thread::yield())
                hxal::dispatch_event(ioc_event(0));
        });
    for (int round = 0; round < 200; ++round)
    {
        Guest guest;
        EXPECT_EQ(hxal_ioc_aen_register(fc, leave, &guest, &guest.handle), HXA_STATUS_OK);
        while (guest.left == HXA_STATUS_PENDING)
            std::this_thread::yield();
        EXPECT_EQ(guest.left, HXA_STATUS_OK) << round;
    }
    stop = true;
    dispatcher.join();
}

TEST_F(Aen, registrations_end_once)
{
    const std::pair<std::function<hxa_status_t(Listener&)>, bool> kinds[] = {
        {[&](Listener& to) { return listen_adapter(to, adapter); }, false},
        {[&](Listener& to) { return listen_port(to, fc, {}); }, true},
        {[&](Listener& to) { return listen_lport(to, fc, {}); }, false},
        {[&](Listener& to) { return listen_rport(to, fc, {}); }, true},
        {[&](Listener& to) { return listen_itnim(to, fc, {}); }, false},
        {[&](Listener& to) { return listen_audit(to, fc, {}); }, true},
        {[&](Listener& to) { return listen_ioc(to, fc); }, true},
        {[&](Listener& to) { return listen_ethport(to, eth); }, true},
    };
    for (const auto& [enlist, tells] : kinds)
    {
        Listener listener(heard, "");
        ASSERT_EQ(enlist(listener), HXA_STATUS_OK);
        const auto end = std::exchange(listener.unregister, {});
        testing::internal::CaptureStdout();
        EXPECT_EQ(end(), HXA_STATUS_OK);
        EXPECT_EQ(testing::internal::GetCapturedStdout(), "");
        testing::internal::CaptureStdout();
        EXPECT_EQ(end(), HXA_STATUS_FAILED);
        std::fflush(stdout);
        EXPECT_THAT(testing::internal::GetCapturedStdout(),
                    testing::MatchesRegex(tells ? "Event callback not registered for handle: 0x[0-9a-f]+\n" : ""));
    }
}

TEST_F(Aen, refuses_a_registration_that_could_not_be_called)
{
    hxal_audit_aen_cbhandle_t* handle = nullptr;
    hxa_audit_aen_data_t data{};
    EXPECT_EQ(hxal_audit_aen_register(fc, nullptr, nullptr, &data, &handle), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_audit_aen_register(fc, hear_event, nullptr, nullptr, &handle), HXA_STATUS_EINVAL);
    EXPECT_EQ(hxal_audit_aen_register(fc, hear_event, nullptr, &data, nullptr), HXA_STATUS_EINVAL);
    EXPECT_EQ(handle, nullptr);
}

TEST_F(Aen, has_codes_of_the_HBA_API)
{
    std::vector<std::array<uint32_t, 3>> codes;
    for (uint32_t category = 0; category <= HXA_AEN_MAX_CAT + 1; ++category)
        for (uint32_t type = 0; type <= 16; ++type)
            if (const uint32_t code = hxal_snia_event_convert(category, type))
                codes.push_back({category, type, code});
    using Row = std::array<uint32_t, 3>;
    EXPECT_THAT(codes, ElementsAre(Row{1, 1, 0x101}, Row{1, 2, 0x102}, Row{3, 3, 0x202}, Row{3, 4, 0x201}, Row{5, 1, 0x402},
                                   Row{5, 2, 0x401}, Row{5, 3, 0x403}));
}

// What callbacks of the short forms write down.
template <typename... Values> void hear_numbers(void* listener, Values... values)
{
    std::string text;
    ((text += (text.empty() ? "" : " ") + std::to_string(values)), ...);
    static_cast<Listener*>(listener)->hear(text);
}

template <typename Full_Form, typename Short_Form> Full_Form disguised(Short_Form callback)
{
    return reinterpret_cast<Full_Form>(reinterpret_cast<void (*)()>(callback));
}

TEST_F(Aen, tells_in_the_short_form_who_asks_for_it)
{
    Listener card(heard, "card");
    Listener port(heard, "port");
    Listener nexus(heard, "nexus");
    const auto adapter_form = disguised<hxal_adapter_aen_cbfn_t>(static_cast<hxal_adapter_snia_cbfn_t>(hear_numbers));
    const auto lport_form = disguised<hxal_lport_aen_cbfn_t>(static_cast<hxal_lport_snia_cbfn_t>(hear_numbers));
    const auto itnim_form = disguised<hxal_itnim_aen_cbfn_t>(static_cast<hxal_itnim_snia_cbfn_t>(hear_numbers));
    const wwn_t base = port_wwn(0, 0);
    listen_adapter(card, adapter, adapter_form, HXAL_AEN_SNIA);
    listen_lport(port, fc, lport_data(base), lport_form, HXAL_AEN_SNIA);
    listen_itnim(nexus, fc, itnim_data(a_wwn, 0), itnim_form, HXAL_AEN_SNIA);

    hxal::dispatch_event(adapter_event(HXA_ADAPTER_AEN_REMOVE, "ZMC0000001", a_wwn));
    hxal::dispatch_event(lport_event(0, HXA_LPORT_AEN_OFFLINE, base));
    hxal::dispatch_event(itnim_event(0, a_wwn, b_wwn));
    EXPECT_THAT(commands(), ElementsAre("IOCMD_LPORT_GET_ATTR"));
    fail("IOCMD_LPORT_GET_ATTR", EIO);
    hxal::dispatch_event(lport_event(0, HXA_LPORT_AEN_OFFLINE, base));
    hxa_port_attr_t attributes{};
    hxasim::clear_faults();
    hxal_lport_get_attr(fc, 0, base, &attributes);
    ASSERT_NE(attributes.pid, 0U);
    const auto numbers = [](auto... values)
    {
        std::string text;
        ((text += " " + std::to_string(values)), ...);
        return text;
    };
    EXPECT_THAT(heard.take(), ElementsAre("card" + numbers(a_wwn, 0x102), "port" + numbers(base, 0x201, attributes.pid),
                                          "nexus" + numbers(a_wwn, b_wwn, 0x402), "port" + numbers(base, 0x201, 0)));
}

TEST_F(Aen, loses_no_event_after_one_of_an_IOC_that_has_gone)
{
    Listener full(heard, "full");
    Listener brief(heard, "brief");
    Listener behind(heard, "behind");
    const auto form = disguised<hxal_lport_aen_cbfn_t>(static_cast<hxal_lport_snia_cbfn_t>(hear_numbers));
    listen_lport(behind, fc, lport_data(a_wwn));
    listen_lport(brief, fc, lport_data(a_wwn), form, HXAL_AEN_SNIA);
    listen_lport(full, fc, lport_data(a_wwn));
    scan("{}");
    hxal::dispatch_event(lport_event(0, HXA_LPORT_AEN_ONLINE, a_wwn));
    EXPECT_THAT(heard.take(), ElementsAre("full 3")) << "the dispatch ends where no address can be had";
    scan_anew();
    hxal::dispatch_event(lport_event(0, HXA_LPORT_AEN_ONLINE, a_wwn));
    EXPECT_EQ(heard.take().size(), 3U);
}

TEST(Aen_Messages, name_every_event_of_their_categories_once)
{
    const std::pair<int, int> categories[] = {
        {HXA_AEN_CAT_ADAPTER, HXA_ADAPTER_AEN_REMOVE},  {HXA_AEN_CAT_AUDIT, HXA_AUDIT_AEN_AUTH_DISABLE},
        {HXA_AEN_CAT_ETHPORT, HXA_ETHPORT_AEN_DISABLE}, {HXA_AEN_CAT_IOC, HXA_IOC_AEN_INVALID_VENDOR},
        {HXA_AEN_CAT_ITNIM, HXA_ITNIM_AEN_DISCONNECT},  {HXA_AEN_CAT_LPORT, HXA_LPORT_AEN_NPIV_UNKNOWN},
        {HXA_AEN_CAT_PORT, HXA_PORT_AEN_SFP_UNSUPPORT}, {HXA_AEN_CAT_RPORT, HXA_RPORT_AEN_QOS_FLOWID}};
    const hxal_aen_msg_t* row = hxal_aen_msg_array;
    for (const auto& [category, last] : categories)
    {
        std::set<int> events;
        for (; row->id >> 16 == category; ++row)
        {
            events.insert(row->id & 0xFFFF);
            const std::string format = row->format;
            const auto arguments = std::count(format.begin(), format.end(), '%');
            EXPECT_EQ(arguments, row->int_args + row->text_args) << row->name;
            EXPECT_TRUE(row->severity >= 1 && row->severity <= 4) << row->name;
        }
        EXPECT_EQ(events.size(), static_cast<std::size_t>(last)) << category;
        EXPECT_EQ(*events.rbegin(), last);
    }
    EXPECT_EQ(row->id, 0);
}

} // namespace
