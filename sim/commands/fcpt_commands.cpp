// FC pass-through: a frame from a logical port into the simulated fabric. The name server answers; nobody else does.
#include "sim/commands/caller_memory.h"
#include "sim/commands/lport_requests.h"
#include "sim/commands/name_server.h"
#include "sim/commands/row.h"
#include "sim/model/record_fields.h"

#include <algorithm>
#include <cerrno>

namespace hxasim
{

namespace
{

constexpr std::uint8_t directory_server[] = {0xFF, 0xFF, 0xFC};
constexpr std::uint8_t fc_services = 0x20;
constexpr std::uint8_t extended_link_service = 0x01;
constexpr std::size_t longest_request = 64 * 1024;

bool is_for_name_server(const fchs_t& header)
{
    return header.type == fc_services && std::memcmp(header.d_id, directory_server, sizeof(directory_server)) == 0;
}

bool is_from(const fchs_t& header, const Logical_Port& port)
{
    const auto address = wire_address(port.address);
    return std::equal(address.begin(), address.end(), header.s_id);
}

// What a frame that asks for something never goes without (FC-FS-2); null when nothing is missing.
const char* missing_in(const fchs_t& header)
{
    const auto is_empty = [](const auto& field)
    { return std::all_of(std::begin(field), std::end(field), [](std::uint8_t byte) { return byte == 0; }); };
    if (header.r_ctl == 0)
        return "R_CTL";
    if (is_empty(header.d_id))
        return "D_ID";
    if (header.type == 0)
        return "TYPE";
    return is_empty(header.f_ctl) ? "F_CTL" : nullptr;
}

void count_exchange(Ioc& ioc)
{
    auto& counters = ioc.port->counters;
    if (ioc.type == HXA_IOC_TYPE_FCoE)
    {
        ++counters.fcoe->txf_ucast;
        ++counters.fcoe->rxf_ucast;
        return;
    }
    ++counters.fc->tx_frames;
    ++counters.fc->rx_frames;
}

// Whether the record's sender may send at all; sets its status when not.
bool may_send(Call& call, hxa_ioctl_fcpt_t& record, const Logical_Port& logical)
{
    if (!is_on_line(*call.ioc))
        record.status = HXA_STATUS_PORT_OFFLINE;
    else if (!is_from(record.fchs, logical))
        record.status = HXA_STATUS_BADFRMHDR;
    else if (record.reqsz > longest_request)
        record.status = HXA_STATUS_BADFRMSZ;
    else if (record.dpwwn != 0)
    {
        const auto* remote = remote_port_of(call, record, record.lpwwn, record.dpwwn);
        if (remote && remote->state != HXA_RPORT_ONLINE)
            record.status = HXA_STATUS_RPORT_OFFLINE;
    }
    return record.status == HXA_STATUS_OK;
}

void exchange_with_name_server(Call& call, hxa_ioctl_fcpt_t& record, const Logical_Port& logical)
{
    std::vector<std::uint8_t> request(record.reqsz);
    if (!request.empty() && !copy_from_caller(request, address_of(record.reqbuf_ptr)))
        return call.refuse(EFAULT, "bad address of the request");
    auto response = ask_name_server(logical, request);
    response.resize(std::min<std::size_t>(response.size(), record.rspsz));
    if (!response.empty() && !copy_to_caller(address_of(record.rspbuf_ptr), response))
        return call.refuse(EFAULT, "bad address of the response");
    record.rspsz = static_cast<std::uint32_t>(response.size());
    count_exchange(*call.ioc);
}

void answer_pass_through(Call& call, hxa_ioctl_fcpt_t& record)
{
    if (record.nport_nexus_needed != (record.dpwwn != 0))
        return call.refuse(EINVAL, "needs a nexus: " + std::to_string(record.nport_nexus_needed));
    if (const char* missing = missing_in(record.fchs))
        return call.refuse(EINVAL, std::string("frame without ") + missing);
    const auto* logical = logical_port_of(call, record, record.lpwwn);
    if (!logical || !may_send(call, record, *logical))
        return;
    if (is_for_name_server(record.fchs))
        return exchange_with_name_server(call, record, *logical);
    record.rspsz = 0;
    record.status = record.fchs.type == extended_link_service ? HXA_STATUS_FCPT_LS_RJT : HXA_STATUS_ETIMER;
}

constexpr auto frame = [](auto& record)
{
    return std::tie(record.vf_id, record.lpwwn, record.dpwwn, record.tsecs, record.cts, record.cos, record.fchs,
                    record.nport_nexus_needed, record.reqsz, record.rspsz, record.reqbuf_ptr, record.rspbuf_ptr);
};
constexpr auto fcpt_buffers = [](const auto& record) { return std::vector{Buffer{record.rspbuf_ptr, record.rspsz}}; };

// clang-format off
constexpr Row fcpt_table[] = {
    ioc_row<answer_pass_through>("IOCMD_FCPT", frame, fcpt_buffers),
};
// clang-format on

} // namespace

std::span<const Row> fcpt_rows() { return fcpt_table; }

} // namespace hxasim
