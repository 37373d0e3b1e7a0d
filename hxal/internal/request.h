// Requests to a driver: build a record, then send it. Every request of the library leaves through send().
//
//     auto record = request_for<hxa_ioctl_port_attr_t>(*ioc);
//     if (const hxa_status_t sent = send(*ioc, "IOCMD_PORT_GET_ATTR", record); sent != HXA_STATUS_OK)
//         return sent;                 // the call failed, the record is as it was
//     return record.status;            // what the driver says
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

// Sends the record under the group byte of the IOC's type; the driver answers in it. HXA_STATUS_OK, or the status of errno,
// which is left as the call set it. Waits as long as the driver does.
hxa_status_t transfer(const hxal_s& ioc, const Command& command, void* record);

template <typename Record>
hxa_status_t send(const hxal_s& ioc, Command_Name<std::type_identity_t<Record>> command, Record& record)
{
    return transfer(ioc, command.row, &record);
}

} // namespace hxal
