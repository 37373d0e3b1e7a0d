#include "hxal/diag.h"
#include "cli/commands.h"
#include "cli/field_text.h"
#include "cli/out_of_service.h"
#include "cli/report.h"
#include "cli/words.h"

#include <string_view>

namespace hxa
{

namespace
{

// clang-format off
constexpr Column columns[] = {
    {"Test",            "test"},
    {"Adapter",         "adapter"},
    {"Port",            "port"},
    {"Result",          "result"},
    {"Temperature",     "temperature_celsius", " C"},
    {"Frames sent",     "frames_sent"},
    {"Frames received", "frames_received"},
    {"Outstanding",     "frames_outstanding"},
    {"Bad frame",       "bad_frame"},
    {"Failed at",       "failed_address"},
    {"Expected",        "expected"},
    {"Found",           "found"},
    {"Algorithm",       "algorithm"},
    {"Queue",           "queue"},
    {"Count",           "count"},
    {"DMA status",      "dma_status"},
    {"Data",            "data"},
};

constexpr struct
{
    const char* word;
    hxa_pport_opmode_t mode;
} modes[] = {{"internal", HXA_PPORT_OPMODE_LB_INT}, {"external", HXA_PPORT_OPMODE_LB_EXT}, {"cable", HXA_PPORT_OPMODE_LB_CBL}};
// clang-format on

hxa_pport_opmode_t read_mode(const std::string& text)
{
    for (const auto& row : modes)
        if (text == row.word)
            return row.mode;
    throw Failure(Exit::usage, "\"" + safe_text(text) + "\" is no mode: internal, external or cable");
}

// The answer to a test: passed, or what the driver says; the program exits with 1 then.
void answer(Session& session, const Diag_Options& options, Member element, hxa_status_t status, Object found)
{
    Object tree{{"test", options.action},
                std::move(element),
                {"passed", status == HXA_STATUS_OK},
                {"result", status == HXA_STATUS_OK ? "passed" : status_text(status)}};
    for (auto& member : found)
        tree.push_back(std::move(member));
    session.answer(tree, details(tree, columns));
    if (status != HXA_STATUS_OK)
        session.fail();
}

void temperature(Session& session, const Adapter& adapter, const Diag_Options& options)
{
    std::uint16_t celsius = 0;
    const auto status = hxal_diag_tsensor_query(adapter.ioc(), &celsius);
    answer(session, options, {"adapter", adapter.number}, status,
           status == HXA_STATUS_OK ? Object{{"temperature_celsius", unsigned{celsius}}} : Object{});
}

void memory(Session& session, const Adapter& adapter, const Diag_Options& options)
{
    hxa_diag_memtest_result_t result{};
    hxa_status_t status;
    {
        const Out_Of_Service out(session, adapter, "memory test");
        status = hxal_diag_memtest(adapter.ioc(), options.pattern, &result);
    }
    Object found;
    if (status == HXA_STATUS_MEMTEST_FAILED)
        found = {{"failed_address", hexadecimal(result.addr, 8)},
                 {"expected", hexadecimal(result.exp, 8)},
                 {"found", hexadecimal(result.act, 8)},
                 {"algorithm", unsigned{result.algo}}};
    answer(session, options, {"adapter", adapter.number}, status, std::move(found));
}

void loopback(Session& session, const Port& port, const Diag_Options& options)
{
    const auto mode = read_mode(options.mode);
    const auto speed = read_speed(options.speed);
    const std::uint32_t count = options.count ? options.count : 8192;
    const bool ethernet = options.ethernet || !port.fc;
    if (ethernet && !port.ethernet)
        throw Failure(Exit::no_such_element, "port " + port.name() + " has no Ethernet function");
    if (ethernet && mode == HXA_PPORT_OPMODE_LB_INT) // refused all the same, but only once the port is out of service
        throw Failure(Exit::usage, "an Ethernet function takes the modes external and cable");
    hxa_diag_loopback_result_t result{};
    hxa_status_t status;
    {
        const Out_Of_Service out(session, port, "loopback test");
        status = ethernet ? hxal_diag_eth_loopback(port.ethernet, mode, count, options.pattern, &result)
                          : hxal_diag_loopback(port.fc, mode, speed, count, options.pattern, &result);
    }
    answer(session, options, {"port", port.name()}, status,
           {{"frames_sent", result.numtxmfrm},
            {"frames_received", result.numrcvfrm},
            {"frames_outstanding", result.numosffrm},
            {"bad_frame", result.badfrmnum ? Value(result.badfrmnum) : Value()}});
}

void ping(Session& session, const Port& port, const Diag_Options& options)
{
    const std::uint32_t count = options.count ? options.count : 1;
    hxa_diag_fwping_result_t result{};
    const auto status = hxal_diag_fwping(port.ioc(), count, options.pattern, &result);
    answer(session, options, {"port", port.name()}, status, {{"count", count}, {"dma_status", result.dmastatus}});
}

void queue(Session& session, const Port& port, const Diag_Options& options)
{
    hxa_diag_qtest_result_t result{};
    const auto status = hxal_diag_queuetest(port.ioc(), options.number, &result);
    answer(session, options, {"port", port.name()}, status, {{"queue", options.number}, {"count", unsigned{result.count}}});
}

void registers(Session& session, const Port& port, const Diag_Options& options)
{
    std::vector<std::uint32_t> words(options.count ? options.count : 1);
    const auto status = hxal_diag_regread(port.ioc(), options.number, static_cast<int>(words.size()), words.data());
    List data;
    if (status == HXA_STATUS_OK)
        for (const auto word : words)
            data.push_back(hexadecimal(word, 8));
    answer(session, options, {"port", port.name()}, status, {{"data", data}});
}

} // namespace

void diag(Session& session, const Diag_Options& options)
{
    const Host host(session);
    if (options.action == "temperature")
        temperature(session, host.adapter(options.element), options);
    else if (options.action == "memory")
        memory(session, host.adapter(options.element), options);
    else if (options.action == "loopback")
        loopback(session, host.port(options.element), options);
    else if (options.action == "ping")
        ping(session, host.port(options.element), options);
    else if (options.action == "queue")
        queue(session, host.port(options.element), options);
    else
        registers(session, host.port(options.element), options);
}

} // namespace hxa
