// The commands that the simulated drivers answer: one row each, with what the sender may put into the record.
//
// To add a command: write its answer (a function that fills the record in place) beside its family, and add its row.
#pragma once

#include "sim/host.h"

#include "hxal/records/commands.h"

#include <array>
#include <optional>
#include <span>
#include <string>

namespace hxasim
{

// An open node.
struct Descriptor
{
    Node node;
    std::uint64_t host_number; // of the host that it was opened on
};

// One request while it is answered. The answer sets `status` in its record, or refuses the whole call.
struct Call
{
    Host& host;
    Descriptor& descriptor;
    Ioc* ioc;             // null for a request to the driver as a whole
    int error = 0;        // errno that the call fails with
    std::string why = {}; // what was wrong with it

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

using Answer = void (*)(Call& call, std::span<std::uint8_t> record);

struct Row
{
    const hxal::Command* command;
    Target target;
    std::optional<std::size_t> status; // where the record keeps its status
    std::array<Field, 4> inputs;       // what the sender sets besides the instance; all other bytes come in as 0
    Answer answer;
};

// Where requests to one IOC carry its instance.
inline constexpr Field instance_field{.offset = offsetof(hxa_ioctl_gen_t, hxad_num), .size = sizeof(hxa_ioctl_gen_t::hxad_num)};

constexpr std::size_t max_record_size = 4096;

// Null when no row has it.
const Row* row_of(const hxal::Command& command);
const Row* row_named(std::string_view name);

// The answers, by the file that holds them.
void answer_version(Call& call, hxa_ioctl_ioc_get_version_t& record); // driver_commands.cpp
void answer_instances(Call& call, hxa_ioctl_ioc_get_inst_t& record);
void answer_event_sync(Call& call, hxa_ioctl_aen_t& record);
void answer_ioc_info(Call& call, hxa_ioctl_ioc_info_t& record); // ioc_commands.cpp
void answer_ioc_attributes(Call& call, hxa_ioctl_ioc_attr_t& record);
void answer_ioc_enable(Call& call, hxa_ioctl_gen_t& record);
void answer_ioc_disable(Call& call, hxa_ioctl_gen_t& record);
void answer_ioc_statistics(Call& call, hxa_ioctl_ioc_stats_t& record);
void answer_ioc_reset_statistics(Call& call, hxa_ioctl_gen_t& record);
void answer_ioc_power(Call& call, hxa_ioctl_ioc_power_t& record);
void answer_adapter_name(Call& call, hxa_ioctl_ioc_set_adapter_name_t& record);
void answer_port_name(Call& call, hxa_ioctl_ioc_set_adapter_name_t& record);
void answer_iocfc_attributes(Call& call, hxa_ioctl_iocfc_attr_t& record); // iocfc_commands.cpp
void answer_iocfc_interrupts(Call& call, hxa_ioctl_iocfc_intr_t& record);
void answer_iocfc_statistics(Call& call, hxa_ioctl_iocfc_stats_t& record);
void answer_iocfc_reset_statistics(Call& call, hxa_ioctl_gen_t& record);
void answer_port_attributes(Call& call, hxa_ioctl_port_attr_t& record);   // port_commands.cpp
void answer_flash_attributes(Call& call, hxa_ioctl_flash_attr_t& record); // flash_commands.cpp
void answer_flash_erase(Call& call, hxa_ioctl_flash_t& record);
void answer_flash_update(Call& call, hxa_ioctl_flash_t& record);
void answer_flash_read(Call& call, hxa_ioctl_flash_t& record);
void answer_flash_manufacturing(Call& call, hxa_ioctl_flash_mfg_t& record);
void answer_optrom_enable(Call& call, hxa_ioctl_gen_t& record);
void answer_optrom_disable(Call& call, hxa_ioctl_gen_t& record);

} // namespace hxasim
