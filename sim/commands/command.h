// What a command is to the simulated drivers: one row, with what the sender may put into the record, and its answer. The rows
// stand at the end of the file that holds their answers (row.h).
#pragma once

#include "sim/model/host.h"

#include "hxal/records/commands.h"

#include <bitset>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace hxasim
{

// An open node. It is readable while the application has events to fetch from one of the IOCs that it knows.
struct Descriptor
{
    Node node;
    std::uint64_t host_number;                     // of the host that it was opened on
    std::optional<std::uint32_t> application = {}; // that synchronised on it
    std::bitset<max_instances> known{};            // IOCs that were there then
    bool readable = false;                         // now
    bool inherited = false;                        // from the process that this one was forked from, which makes it readable
};

// One request while it is answered. The answer sets `status` in its record, or refuses the whole call.
struct Call
{
    Host& host;
    Descriptor& descriptor;
    Ioc* ioc;                                    // null for a request to the driver as a whole
    int error = 0;                               // errno that the call fails with
    std::string why = {};                        // what was wrong with it
    std::optional<std::size_t> answer_size = {}; // bytes of the record that go back, where not all do

    void refuse(int errno_value, std::string reason)
    {
        error = errno_value;
        why = std::move(reason);
    }
};

struct Field
{
    std::size_t offset = 0;
    std::size_t size = 0;
};

// Whom a request is for.
enum class Target : std::uint8_t
{
    driver,
    ioc
};

// Memory of the sender's for an answer that is not in the record.
struct Buffer
{
    std::uint64_t pointer;
    std::uint64_t size; // bytes
};

struct Row
{
    const hxal::Command* command;
    Target target;
    std::size_t record_size;                // largest one that is answered
    std::size_t sent_size;                  // what of it is read from the sender
    Field instance;                         // where the record carries it, in a request to one IOC
    std::optional<std::size_t> status;      // where the record keeps its status
    std::optional<std::size_t> remote_port; // where the record names one
    bool of_absent;                         // answered also for an IOC whose card is gone
    bool is_scsi;                           // the record is a hxa_ioctl_scsi_t

    // Makes 0 of what the sender may set, the instance included: what is left has to be 0.
    void (*clear_inputs)(std::span<std::uint8_t> record);

    // The buffers that a record refers to, the one for data first; null where records of this kind do not.
    std::vector<Buffer> (*buffers)(std::span<const std::uint8_t> record);

    // `record` comes in as it was sent and goes out as it is to be answered.
    void (*answer)(Call& call, std::vector<std::uint8_t>& record);
};

// The row of a command; null when none has it.
const Row* row_of(const hxal::Command& command);
const Row* row_named(std::string_view name);

// The rows, by the file that ends with them.
std::span<const Row> driver_rows();
std::span<const Row> ioc_rows();
std::span<const Row> iocfc_rows();
std::span<const Row> event_rows();
std::span<const Row> diag_rows();
std::span<const Row> port_rows();
std::span<const Row> port_config_rows();
std::span<const Row> statistics_rows();
std::span<const Row> ethport_rows();
std::span<const Row> sfp_rows();
std::span<const Row> flash_rows();
std::span<const Row> lport_rows();
std::span<const Row> rport_rows();
std::span<const Row> itnim_rows();
std::span<const Row> scsi_rows();
std::span<const Row> fcpt_rows();

} // namespace hxasim
