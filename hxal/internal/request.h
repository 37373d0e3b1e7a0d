// Requests to a driver: build a record, then send it. Every request of the library leaves through send().
//
//     auto record = request_for<hxa_ioctl_port_attr_t>(*ioc);
//     return exchange(*ioc, "IOCMD_PORT_GET_ATTR", record, &hxa_ioctl_port_attr_t::attr, attr);
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/commands.h"

#include <algorithm>
#include <type_traits>

namespace hxal
{

// The catalogue's row of a name. A name that is not in the catalogue, or stands there with another record, does not compile.
template <typename Record> class Command_Name
{
public:
    consteval Command_Name(const char* name)
        : row(*std::find_if(catalogue.begin(), catalogue.end(),
                            [=](const Command& command)
                            { return command.name == name && command.record == &record_tag<Record>; }))
    {
    }

    Command row;
};

// A record of zeros for the IOC.
template <typename Record> Record request_for(const hxal_s& ioc)
{
    static_assert(offsetof(Record, hxad_num) == offsetof(hxa_ioctl_gen_t, hxad_num));
    Record record{};
    record.hxad_num = static_cast<uint16_t>(ioc.instance);
    return record;
}

// A buffer's address as a record refers to it: 8 bytes on every host.
inline uint64_t sender_address(const void* buffer) { return reinterpret_cast<uintptr_t>(buffer); }

// Sends the record under the group byte of the IOC's type; the driver answers in it. HXA_STATUS_OK, or the status of errno,
// which is left as the call set it. Waits as long as the driver does.
hxa_status_t transfer(const hxal_s& ioc, const Command& command, void* record);

// Says on standard output which call failed, and why, as errno has it.
void tell_failure(const Command& command);

template <typename Record>
hxa_status_t send(const hxal_s& ioc, Command_Name<std::type_identity_t<Record>> command, Record& record)
{
    return transfer(ioc, command.row, &record);
}

// Sends the record: the status of errno when the call fails, else what the driver says.
template <typename Record>
hxa_status_t exchange(const hxal_s& ioc, Command_Name<std::type_identity_t<Record>> command, Record& record)
{
    const hxa_status_t sent = send(ioc, command, record);
    return sent == HXA_STATUS_OK ? record.status : sent;
}

// The same, and copies a field of the answer out, whatever the driver says; a call that fails leaves the caller's buffer alone,
// which may be missing.
template <typename Record, typename Output>
hxa_status_t exchange(const hxal_s& ioc, Command_Name<std::type_identity_t<Record>> command, Record& record,
                      Output Record::*field, Output* output)
{
    if (const hxa_status_t sent = send(ioc, command, record); sent != HXA_STATUS_OK)
        return sent;
    if (output)
        *output = record.*field;
    return record.status;
}

// A request that carries nothing but the instance and brings a field. A call that fails is told on standard output.
template <typename Record, typename Output>
hxa_status_t read_or_tell(const hxal_t* ioc, Command_Name<std::type_identity_t<Record>> command, Output Record::*field,
                          Output* output)
{
    if (!ioc || !output)
        return HXA_STATUS_EINVAL;
    auto record = request_for<Record>(*ioc);
    if (const hxa_status_t sent = send(*ioc, command, record); sent != HXA_STATUS_OK)
    {
        tell_failure(command.row);
        return sent;
    }
    *output = record.*field;
    return record.status;
}

// A request that carries nothing but the instance.
inline hxa_status_t request(const hxal_t* ioc, Command_Name<hxa_ioctl_gen_t> command)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = request_for<hxa_ioctl_gen_t>(*ioc);
    return exchange(*ioc, command, record);
}

// A request that carries nothing but the instance and brings a field.
template <typename Record, typename Output>
hxa_status_t read(const hxal_t* ioc, Command_Name<std::type_identity_t<Record>> command, Output Record::*field, Output* output)
{
    if (!ioc || !output)
        return HXA_STATUS_EINVAL;
    auto record = request_for<Record>(*ioc);
    return exchange(*ioc, command, record, field, output);
}

} // namespace hxal
