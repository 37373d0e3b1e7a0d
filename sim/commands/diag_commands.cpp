// Diagnostic requests to an I/O controller and the port behind it.
#include "sim/commands/caller_memory.h"
#include "sim/commands/row.h"

#include <endian.h>

#include <algorithm>
#include <cerrno>

namespace hxasim
{

namespace
{

constexpr std::uint32_t register_space = 256 * 1024; // bytes
constexpr std::uint32_t queues = 4;

bool is_operational(const Ioc& ioc) { return *ioc.state == HXA_IOC_OPERATIONAL; }

// Whether a row of registers exists.
bool are_registers(std::uint32_t offset, std::uint32_t words)
{
    return offset % 4 == 0 && offset < register_space && words != 0 && words <= (register_space - offset) / 4;
}

bool is_disabled(const Adapter& adapter)
{
    return std::all_of(adapter.ports.begin(), adapter.ports.end(),
                       [&](const Port& port) {
                           return port.ioc_state == HXA_IOC_DISABLED &&
                                  (!adapter.converged() || port.eth_ioc_state == HXA_IOC_DISABLED);
                       });
}

// Why a test cannot use the firmware; HXA_STATUS_OK when it can.
hxa_status_t firmware_refusal(const Ioc& ioc)
{
    if (!is_operational(ioc))
        return HXA_STATUS_IOC_NON_OP;
    return ioc.port->loopback_test ? HXA_STATUS_DIAG_BUSY : HXA_STATUS_OK;
}

bool leaves_the_chip(std::uint32_t mode) { return mode == HXA_PPORT_OPMODE_LB_EXT || mode == HXA_PPORT_OPMODE_LB_CBL; }

// Why a loopback test cannot run; HXA_STATUS_OK when it can.
hxa_status_t loopback_refusal(const Ioc& ioc, std::uint32_t mode)
{
    if (const auto refusal = firmware_refusal(ioc); refusal != HXA_STATUS_OK)
        return refusal;
    if (!is_out_of_service(own_state(ioc)))
        return ioc.type == HXA_IOC_TYPE_LL ? HXA_STATUS_CEE_NOT_DN : HXA_STATUS_PORT_NOT_DISABLED;
    if (leaves_the_chip(mode))
        return ioc.port->sfp.present ? HXA_STATUS_OK : HXA_STATUS_NO_SFP_DEV;
    return mode == HXA_PPORT_OPMODE_LB_INT ? HXA_STATUS_OK : HXA_STATUS_CMD_NOTSUPP;
}

// Every frame that is sent comes back.
hxa_diag_loopback_result_t all_frames(std::uint32_t count)
{
    hxa_diag_loopback_result_t result{};
    result.numtxmfrm = count;
    result.numrcvfrm = count;
    return result;
}

void answer_register_read(Call& call, hxa_ioctl_diag_regread_t& record)
{
    if (!are_registers(record.off, record.nwords))
    {
        record.status = HXA_STATUS_EINVAL;
        return;
    }
    std::vector<std::uint8_t> bytes(record.nwords * sizeof(std::uint32_t));
    for (const auto& [offset, word] : call.ioc->registers)
        if (offset >= record.off && offset - record.off < bytes.size())
            std::memcpy(&bytes[offset - record.off], &word, sizeof(word));
    if (!copy_to_caller(address_of(record.buf_ptr), bytes))
        call.refuse(EFAULT, "bad buffer address");
}

void answer_register_write(Call& call, hxa_ioctl_diag_regwrite_t& record)
{
    if (are_registers(record.off, 1))
        call.ioc->registers[record.off] = record.word;
    else
        record.status = HXA_STATUS_EINVAL;
}

void answer_temperature(Call& call, hxa_ioctl_diag_get_temp_t& record)
{
    record.status = is_operational(*call.ioc) ? HXA_STATUS_OK : HXA_STATUS_IOC_NON_OP;
    if (record.status == HXA_STATUS_OK)
        record.temp = call.ioc->adapter->temperature;
}

void answer_memory_test(Call& call, hxa_ioctl_diag_memtest_t& record)
{
    if (!is_disabled(*call.ioc->adapter))
        record.status = HXA_STATUS_ADAPTER_ENABLED;
}

void answer_loopback(Call& call, hxa_ioctl_diag_loopback_t& record)
{
    record.status = loopback_refusal(*call.ioc, record.opmode);
    const bool any_speed = record.speed == HXA_PPORT_SPEED_UNKNOWN;
    if (record.status == HXA_STATUS_OK && !any_speed && !can_run_at(*call.ioc->port, record.speed))
        record.status = HXA_STATUS_UNSUPP_SPEED;
    if (record.status == HXA_STATUS_OK)
        record.result = all_frames(be32toh(record.lpcnt));
}

// The Ethernet driver's own form.
void answer_ethernet_loopback(Call& call, hxa_ioctl_diag_ll_loopback_t& record)
{
    record.status = HXA_STATUS_CMD_NOTSUPP;
    if (call.ioc->type == HXA_IOC_TYPE_LL && leaves_the_chip(record.opmode))
        record.status = loopback_refusal(*call.ioc, record.opmode);
    if (record.status == HXA_STATUS_OK)
        record.result = all_frames(record.lpcnt);
}

void answer_loopback_status(Call& call, hxa_ioctl_diag_lb_stat_t& record)
{
    record.status = call.ioc->port->loopback_test ? HXA_STATUS_DIAG_BUSY : HXA_STATUS_OK;
}

void answer_firmware_ping(Call& call, hxa_ioctl_diag_fwping_t& record)
{
    record.status = firmware_refusal(*call.ioc);
    if (record.status == HXA_STATUS_OK)
        std::fill(std::begin(record.result.data), std::end(record.result.data), record.pattern);
}

void answer_queue_test(Call& call, hxa_ioctl_diag_qtest_t& record)
{
    record.status = firmware_refusal(*call.ioc);
    if (record.status == HXA_STATUS_OK && record.queue >= queues)
        record.status = HXA_STATUS_EINVAL;
    if (record.status != HXA_STATUS_OK)
        return;
    record.result.queue = static_cast<std::uint8_t>(record.queue);
    record.result.count = 1;
}

// Command 0 ends a test; any other one starts it.
void answer_led_test(Call& call, hxa_ioctl_diag_led_t& record)
{
    auto& port = *call.ioc->port;
    if (!is_operational(*call.ioc))
        record.status = HXA_STATUS_IOC_NON_OP;
    else if (record.ledtest.cmd == 0)
        port.led_test = false;
    else if (port.led_test)
        record.status = HXA_STATUS_LEDTEST_OP;
    else if (port.beacon.port_is_on())
        record.status = HXA_STATUS_BEACON_ON;
    else
        port.led_test = true;
}

void answer_beacon(Call& call, hxa_ioctl_diag_beacon_t& record)
{
    if (record.beacon > HXA_TRUE || record.link_e2e_beacon > HXA_TRUE)
        return call.refuse(EINVAL, "a beacon is on or off");
    auto& port = *call.ioc->port;
    if (!is_operational(*call.ioc))
        record.status = HXA_STATUS_IOC_NON_OP;
    else if (port.led_test)
        record.status = HXA_STATUS_LEDTEST_OP;
    else
        port.beacon.set(record.beacon != 0, record.link_e2e_beacon != 0, record.second);
}

constexpr auto registers = [](auto& record) { return std::tie(record.off, record.nwords, record.buf_ptr); };
constexpr auto register_word = [](auto& record) { return std::tie(record.off, record.word); };
constexpr auto memory_test = [](auto& record) { return std::tie(record.pat, record.memtest.algo); };
constexpr auto loopback = [](auto& record) { return std::tie(record.opmode, record.speed, record.lpcnt, record.pat); };
constexpr auto ethernet_loopback = [](auto& record) { return std::tie(record.opmode, record.lpcnt, record.pat); };
constexpr auto ping = [](auto& record) { return std::tie(record.cnt, record.pattern); };
constexpr auto queue = [](auto& record) { return std::tie(record.queue); };
constexpr auto led_test = [](auto& record) { return std::tie(record.ledtest); };
constexpr auto beacon = [](auto& record) { return std::tie(record.beacon, record.link_e2e_beacon, record.second); };
constexpr auto diag_buffers = [](const auto& record) {
    return std::vector{Buffer{record.buf_ptr, sizeof(std::uint32_t) * std::uint64_t{record.nwords}}};
};

// clang-format off
constexpr Row diag_table[] = {
    ioc_row<answer_register_read>(    "IOCMD_DIAG_REGREAD",     registers, diag_buffers),
    ioc_row<answer_register_write>(   "IOCMD_DIAG_REGWRITE",    register_word),
    ioc_row<answer_temperature>(      "IOCMD_DIAG_TEMP"),
    ioc_row<answer_memory_test>(      "IOCMD_DIAG_MEMTEST",     memory_test),
    ioc_row<answer_loopback>(         "IOCMD_DIAG_LOOPBACK",    loopback),
    ioc_row<answer_ethernet_loopback>("IOCMD_DIAG_LL_LOOPBACK", ethernet_loopback),
    ioc_row<answer_loopback_status>(  "IOCMD_DIAG_LB_STAT"),
    ioc_row<answer_firmware_ping>(    "IOCMD_DIAG_FWPING",      ping),
    ioc_row<answer_queue_test>(       "IOCMD_DIAG_QUEUETEST",   queue),
    ioc_row<answer_led_test>(         "IOCMD_DIAG_LED",         led_test),
    ioc_row<answer_beacon>(           "IOCMD_DIAG_BEACON",      beacon),
};
// clang-format on

} // namespace

std::span<const Row> diag_rows() { return diag_table; }

} // namespace hxasim
