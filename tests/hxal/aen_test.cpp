// Which registrations an event is for, and in which form they are told of it.
#include "hxal/internal/aen_dispatch.h"
#include "tests/hxal/aen_listeners.h"
#include "tests/hxal/golden.h"

#include <algorithm>
#include <atomic>
#include <thread>

namespace
{

using testing::ElementsAre;

constexpr wwn_t a = 0x1111;
constexpr wwn_t b = 0x2222;

// What each kind looks at.
// clang-format off
hxa_aen_data_t of_port(wwn_t pwwn, mac_t mac = {})      { hxa_aen_data_t d{}; d.port.pwwn = pwwn; d.port.mac = mac; return d; }
hxa_aen_data_t of_lport(wwn_t lpwwn)                    { hxa_aen_data_t d{}; d.lport.lpwwn = lpwwn; return d; }
hxa_aen_data_t of_rport(wwn_t lpwwn)                    { hxa_aen_data_t d{}; d.rport.lpwwn = lpwwn; return d; }
hxa_aen_data_t of_itnim(wwn_t lpwwn, wwn_t rpwwn)       { hxa_aen_data_t d{}; d.itnim.lpwwn = lpwwn; d.itnim.rpwwn = rpwwn; return d; }
hxa_aen_data_t of_audit(wwn_t pwwn)                     { hxa_aen_data_t d{}; d.audit.pwwn = pwwn; return d; }
hxa_aen_data_t of_ethport(mac_t mac)                    { hxa_aen_data_t d{}; d.ethport.mac = mac; return d; }
// clang-format on
hxa_aen_data_t of_adapter(const std::string& serial, wwn_t pwwn = 0)
{
    hxa_aen_data_t data{};
    serial.copy(data.adapter.serial_num, sizeof data.adapter.serial_num);
    data.adapter.pwwn = pwwn;
    return data;
}

hxa_aen_entry_t event(int category, int type, int instance, const hxa_aen_data_t& data = {})
{
    hxa_aen_entry_t entry{};
    entry.aen_category = static_cast<uint32_t>(category);
    entry.aen_type = static_cast<uint32_t>(type);
    entry.hxad_num = instance;
    entry.aen_data = data;
    return entry;
}
hxa_aen_entry_t ioc_event(int instance) { return event(HXA_AEN_CAT_IOC, HXA_IOC_AEN_ENABLE, instance); }

TEST_F(Aen, reaches_the_registrations_that_match)
{
    const mac_t mac = eth_mac(0, 0);
    const mac_t other_mac = eth_mac(0, 1);
    const auto card = HXA_AEN_CAT_ADAPTER, port = HXA_AEN_CAT_PORT, lport = HXA_AEN_CAT_LPORT, rport = HXA_AEN_CAT_RPORT,
               itnim = HXA_AEN_CAT_ITNIM, audit = HXA_AEN_CAT_AUDIT, ioc = HXA_AEN_CAT_IOC, ethport = HXA_AEN_CAT_ETHPORT;
    const auto added = HXA_LPORT_AEN_NEW, online = HXA_LPORT_AEN_ONLINE;
    const struct
    {
        const hxal_t* ioc; // of the registration; for cards: whether it is for this one
        hxa_aen_data_t filter;
        hxa_aen_category_t kind;
        int type, instance; // of the event
        hxa_aen_data_t data;
        bool heard;
    } cases[] = {
        // clang-format off
        {nullptr, {},               card,    HXA_ADAPTER_AEN_ADD,    9, of_adapter("anything"),        true},
        {nullptr, {},               card,    HXA_ADAPTER_AEN_REMOVE, 9, of_adapter("ZMC0000001"),      false},
        {fc,      {},               card,    HXA_ADAPTER_AEN_REMOVE, 9, of_adapter("ZMC0000001"),      true},
        {fc,      {},               card,    HXA_ADAPTER_AEN_ADD,    9, of_adapter("ZMC0000001"),      true},
        {fc,      {},               card,    HXA_ADAPTER_AEN_REMOVE, 9, of_adapter("ZMC0000002"),      false},
        {fc,      {},               card,    HXA_ADAPTER_AEN_REMOVE, 9, of_adapter("ZMC000000123456"), false},
        {fc,      of_port(a),       port,    HXA_PORT_AEN_ONLINE,    0, of_port(a, mac),               true},
        {fc,      of_port(a, mac),  port,    HXA_PORT_AEN_ONLINE,    0, of_port(b, mac),               false}, // only the WWN counts
        {fc,      of_port(a),       port,    HXA_PORT_AEN_ONLINE,    1, of_port(a, mac),               false},
        {fc,      of_port(0),       port,    HXA_PORT_AEN_ONLINE,    0, of_port(0, mac),               false},
        {eth,     of_port(a, mac),  port,    HXA_PORT_AEN_ONLINE,    0, of_port(b, mac),               true},
        {eth,     of_port(a, mac),  port,    HXA_PORT_AEN_ONLINE,    0, of_port(a, other_mac),         false}, // only the MAC counts
        {fc,      of_lport(a),      lport,   online,                 0, of_lport(a),                   true},
        {fc,      of_lport(a),      lport,   online,                 0, of_lport(b),                   false},
        {fc,      of_lport(a),      lport,   online,                 1, of_lport(a),                   false},
        {fc,      of_lport(a),      lport,   added,                  0, of_lport(a),                   false},
        {fc,      of_lport(0),      lport,   added,                  0, of_lport(a),                   true},
        {fc,      of_lport(0),      lport,   added,                  1, of_lport(a),                   false},
        {fc,      of_lport(0),      lport,   online,                 0, of_lport(a),                   false},
        {fc,      of_rport(a),      rport,   HXA_RPORT_AEN_ONLINE,   0, of_rport(a),                   true},
        {fc,      of_rport(a),      rport,   HXA_RPORT_AEN_ONLINE,   0, of_rport(b),                   false},
        {fc,      of_rport(a),      rport,   HXA_RPORT_AEN_ONLINE,   1, of_rport(a),                   false},
        {fc,      of_itnim(a, b),   itnim,   HXA_ITNIM_AEN_ONLINE,   0, of_itnim(a, b),                true},
        {fc,      of_itnim(a, b),   itnim,   HXA_ITNIM_AEN_ONLINE,   0, of_itnim(a, a),                false},
        {fc,      of_itnim(a, b),   itnim,   HXA_ITNIM_AEN_ONLINE,   1, of_itnim(a, b),                false},
        {fc,      of_itnim(a, 0),   itnim,   HXA_ITNIM_AEN_ONLINE,   0, of_itnim(a, b),                true},
        {fc,      of_itnim(a, 0),   itnim,   HXA_ITNIM_AEN_ONLINE,   0, of_itnim(b, b),                false},
        {fc,      of_audit(a),      audit,   HXA_AUDIT_AEN_AUTH_ENABLE, 0, of_audit(a),                true},
        {fc,      of_audit(a),      audit,   HXA_AUDIT_AEN_AUTH_ENABLE, 0, of_audit(b),                false},
        {fc,      of_audit(a),      audit,   HXA_AUDIT_AEN_AUTH_ENABLE, 1, of_audit(a),                false},
        {fc,      {},               ioc,     HXA_IOC_AEN_ENABLE,     0, {},                            true},
        {fc,      {},               ioc,     HXA_IOC_AEN_ENABLE,     1, {},                            false},
        {nullptr, {},               ioc,     HXA_IOC_AEN_ENABLE,     0, {},                            false},
        {eth,     {},               ethport, HXA_ETHPORT_AEN_LINKUP, 0, of_ethport(mac),               true},
        {eth,     {},               ethport, HXA_ETHPORT_AEN_LINKUP, 0, of_ethport(other_mac),         false},
        {eth,     {},               ethport, HXA_ETHPORT_AEN_LINKUP, 1, of_ethport(mac),               false},
        // clang-format on
    };
    for (const auto& row : cases)
    {
        SCOPED_TRACE(&row - cases);
        Listener listener(heard, "it");
        const bool is_of_card = row.kind == HXA_AEN_CAT_ADAPTER;
        EXPECT_EQ(is_of_card ? listener.listen(row.ioc ? adapter : nullptr) : listener.listen(row.kind, row.ioc, row.filter),
                  HXA_STATUS_OK);
        for (int again = 0; again < 2; ++again) // the mark of the first delivery is gone
        {
            hxal::dispatch_event(event(row.kind, row.type, row.instance, row.data));
            EXPECT_EQ(heard.take().size(), row.heard ? 1U : 0U);
        }
        for (const int of_no_kind : {0, int{HXA_AEN_CAT_TIN}, int{HXA_AEN_CAT_IPFC}, HXA_AEN_MAX_CAT + 1})
            hxal::dispatch_event(event(of_no_kind, row.type, row.instance, row.data));
        EXPECT_EQ(heard.take().size(), 0U);
    }
}

TEST_F(Aen, tells_cards_apart_by_the_last_character_of_their_serial_numbers)
{
    scan(R"({"adapters": [{"kind": "fc-hba", "serial": "A23456789012"}]})");
    Listener listener(heard, "it");
    listener.listen(hxal_adapter_open_idx(1));
    for (const char* serial : {"A23456789012", "A23456789019", "A2345678901"})
        hxal::dispatch_event(event(HXA_AEN_CAT_ADAPTER, HXA_ADAPTER_AEN_REMOVE, 0, of_adapter(serial)));
    EXPECT_THAT(heard.take(), ElementsAre("it 2"));
}

TEST_F(Aen, hands_over_the_drivers_data_and_time)
{
    struct Told
    {
        uint32_t event;
        hxa_port_aen_data_t data;
        hxa_timeval_t time;
    } told{};
    const hxa_aen_data_t data = of_port(a, eth_mac(0, 0));
    hxal_port_aen_cbhandle_t* handle = nullptr;
    const auto callback = [](void* to, uint32_t event, const hxa_port_aen_data_t* from, hxa_timeval_t time) {
        *static_cast<Told*>(to) = {event, *from, time};
    };
    ASSERT_EQ(hxal_port_aen_register(fc, callback, &told, &data.port, &handle), HXA_STATUS_OK);
    auto entry = event(HXA_AEN_CAT_PORT, 12345, 0, data);
    entry.aen_tv = {.tv_sec = 7, .tv_usec = 8};
    hxal::dispatch_event(entry);
    EXPECT_EQ(told.event, 12345U);
    EXPECT_EQ(std::memcmp(&told.data, &data.port, sizeof told.data), 0);
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
    first.listen(HXA_AEN_CAT_IOC, fc);
    second.listen(HXA_AEN_CAT_IOC, fc);
    third.listen(HXA_AEN_CAT_IOC, fc);
    second.then = [&] { EXPECT_EQ(late.listen(HXA_AEN_CAT_IOC, fc), HXA_STATUS_OK); };
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
    for (const auto& [kind, tells] : {std::pair{HXA_AEN_CAT_ADAPTER, false},
                                      {HXA_AEN_CAT_PORT, true},
                                      {HXA_AEN_CAT_LPORT, false},
                                      {HXA_AEN_CAT_RPORT, true},
                                      {HXA_AEN_CAT_ITNIM, false},
                                      {HXA_AEN_CAT_AUDIT, true},
                                      {HXA_AEN_CAT_IOC, true},
                                      {HXA_AEN_CAT_ETHPORT, true}})
    {
        Listener listener(heard, "");
        ASSERT_EQ(kind == HXA_AEN_CAT_ADAPTER ? listener.listen(adapter) : listener.listen(kind, fc), HXA_STATUS_OK);
        const auto end = std::exchange(listener.unregister, {});
        EXPECT_EQ(printed_by([&] { EXPECT_EQ(end(), HXA_STATUS_OK); }), "");
        EXPECT_THAT(printed_by([&] { EXPECT_EQ(end(), HXA_STATUS_FAILED); }),
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

std::string numbers(auto... values)
{
    std::string text;
    ((text += " " + std::to_string(values)), ...);
    return text;
}

// What callbacks of the short forms write down.
template <typename... Values> void hear_numbers(void* listener, Values... values)
{
    static_cast<Listener*>(listener)->hear(numbers(values...).substr(1));
}

TEST_F(Aen, tells_in_the_short_form_who_asks_for_it)
{
    Listener card(heard, "card");
    Listener port(heard, "port");
    Listener nexus(heard, "nexus");
    const wwn_t base = port_wwn(0, 0);
    card.listen(adapter, static_cast<hxal_adapter_snia_cbfn_t>(hear_numbers));
    port.listen(HXA_AEN_CAT_LPORT, fc, of_lport(base), static_cast<hxal_lport_snia_cbfn_t>(hear_numbers));
    nexus.listen(HXA_AEN_CAT_ITNIM, fc, of_itnim(a, 0), static_cast<hxal_itnim_snia_cbfn_t>(hear_numbers));
    hxa_port_attr_t attributes{};
    hxal_lport_get_attr(fc, 0, base, &attributes);
    ASSERT_NE(attributes.pid, 0U);
    hxasim::take_requests();

    hxal::dispatch_event(event(HXA_AEN_CAT_ADAPTER, HXA_ADAPTER_AEN_REMOVE, 0, of_adapter("ZMC0000001", a)));
    hxal::dispatch_event(event(HXA_AEN_CAT_LPORT, HXA_LPORT_AEN_OFFLINE, 0, of_lport(base)));
    hxal::dispatch_event(event(HXA_AEN_CAT_ITNIM, HXA_ITNIM_AEN_ONLINE, 0, of_itnim(a, b)));
    EXPECT_THAT(commands(), ElementsAre("IOCMD_LPORT_GET_ATTR"));
    fail("IOCMD_LPORT_GET_ATTR", EIO);
    hxal::dispatch_event(event(HXA_AEN_CAT_LPORT, HXA_LPORT_AEN_OFFLINE, 0, of_lport(base)));
    EXPECT_THAT(heard.take(), ElementsAre("card" + numbers(a, 0x102), "port" + numbers(base, 0x201, attributes.pid),
                                          "nexus" + numbers(a, b, 0x402), "port" + numbers(base, 0x201, 0)));
}

TEST_F(Aen, loses_no_event_after_one_of_an_IOC_that_has_gone)
{
    Listener full(heard, "full");
    Listener brief(heard, "brief");
    Listener behind(heard, "behind");
    behind.listen(HXA_AEN_CAT_LPORT, fc, of_lport(a));
    brief.listen(HXA_AEN_CAT_LPORT, fc, of_lport(a), static_cast<hxal_lport_snia_cbfn_t>(hear_numbers));
    full.listen(HXA_AEN_CAT_LPORT, fc, of_lport(a));
    scan("{}");
    const auto online = event(HXA_AEN_CAT_LPORT, HXA_LPORT_AEN_ONLINE, 0, of_lport(a));
    hxal::dispatch_event(online);
    EXPECT_THAT(heard.take(), ElementsAre("full 3")) << "the dispatch ends where no address can be had";
    scan_anew();
    hxal::dispatch_event(online);
    EXPECT_EQ(heard.take().size(), 3U);
}

TEST(Aen_Messages, name_every_event_and_fit_their_arguments)
{
    std::string lines;
    for (const hxal_aen_msg_t* row = hxal_aen_msg_array; row->id != 0; ++row)
    {
        const std::string format = row->format;
        EXPECT_EQ(std::ranges::count(format, '%'), row->int_args + row->text_args) << row->name;
        lines += std::to_string(row->id >> 16) + " " + std::to_string(row->id & 0xFFFF) + " " + std::to_string(row->severity) +
                 " " + row->name + ": " + format + "\n";
    }
    EXPECT_EQ(lines, golden("aen_messages.txt"));
}

} // namespace
