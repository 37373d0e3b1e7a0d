// The commands that the simulated drivers answer: one row each, with what the sender may put into the record.
//
// To add a command: write its answer (a function that fills the record in place) beside its family, and add its row.
#pragma once

#include "sim/host.h"

#include "hxal/records/commands.h"

#include <array>
#include <bitset>
#include <optional>
#include <span>
#include <string>

namespace hxasim
{

// An open node. It is readable while the application has events to fetch from one of the IOCs that it knows.
struct Descriptor
{
    Node node;
    std::uint64_t host_number;          // of the host that it was opened on
    std::uint32_t application = 0;      // that synchronised on it; 0: none
    std::bitset<max_instances> known{}; // IOCs that were there then
    bool readable = false;              // now
    bool inherited = false;             // from the process that this one was forked from, which makes it readable
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

// `record` comes in as it was sent and goes out as it is to be answered.
using Answer = void (*)(Call& call, std::vector<std::uint8_t>& record);

struct Row
{
    const hxal::Command* command;
    Target target;
    std::size_t record_size;           // largest one that is answered
    std::size_t sent_size;             // what of it is read from the sender
    Field instance;                    // where the record carries it, in a request to one IOC
    std::optional<std::size_t> status; // where the record keeps its status
    std::array<Field, 4> inputs;       // what the sender sets besides the instance; all other bytes come in as 0
    Answer answer;
    bool of_absent = false; // answered also for an IOC whose card is gone
};

constexpr std::size_t max_record_size = sizeof(hxal_ioctl_aen_t);

// Null when no row has it.
const Row* row_of(const hxal::Command& command);
const Row* row_named(std::string_view name);

// The answers, by the file that holds them.
void answer_version(Call& call, hxa_ioctl_ioc_get_version_t& record); // driver_commands.cpp
void answer_instances(Call& call, hxa_ioctl_ioc_get_inst_t& record);
void answer_event_sync(Call& call, hxa_ioctl_aen_t& record); // event_commands.cpp
void answer_event_fetch(Call& call, hxal_ioctl_aen_t& record);
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
void answer_port_attributes(Call& call, hxa_ioctl_port_attr_t& record); // port_commands.cpp
void answer_port_enable(Call& call, hxa_ioctl_gen_t& record);
void answer_port_disable(Call& call, hxa_ioctl_gen_t& record);
void answer_register_read(Call& call, hxa_ioctl_diag_regread_t& record); // diag_commands.cpp
void answer_register_write(Call& call, hxa_ioctl_diag_regwrite_t& record);
void answer_temperature(Call& call, hxa_ioctl_diag_get_temp_t& record);
void answer_memory_test(Call& call, hxa_ioctl_diag_memtest_t& record);
void answer_loopback(Call& call, hxa_ioctl_diag_loopback_t& record);
void answer_firmware_ping(Call& call, hxa_ioctl_diag_fwping_t& record);
void answer_queue_test(Call& call, hxa_ioctl_diag_qtest_t& record);
void answer_led_test(Call& call, hxa_ioctl_diag_led_t& record);
void answer_beacon(Call& call, hxa_ioctl_diag_beacon_t& record);
void answer_ethernet_loopback(Call& call, hxa_ioctl_diag_ll_loopback_t& record);
void answer_loopback_status(Call& call, hxa_ioctl_diag_lb_stat_t& record);
void answer_sfp_memory(Call& call, hxa_ioctl_sfp_show_t& record); // sfp_commands.cpp
void answer_sfp_media(Call& call, hxa_ioctl_sfp_media_t& record);
void answer_sfp_speed(Call& call, hxa_ioctl_sfp_speed_t& record);
void answer_scsi_command(Call& call, hxa_ioctl_scsi_t& record);           // scsi_commands.cpp
void answer_port_topology(Call& call, hxa_ioctl_port_cfg_topo_t& record); // port_config_commands.cpp
void answer_port_speed(Call& call, hxa_ioctl_port_cfg_speed_t& record);
void answer_port_hard_address(Call& call, hxa_ioctl_port_alpa_t& record);
void answer_port_any_address(Call& call, hxa_ioctl_port_alpa_t& record);
void answer_port_frame_size(Call& call, hxa_ioctl_port_cfg_maxfrsize_t& record);
void answer_port_trunk(Call& call, hxa_ioctl_port_trunk_t& record);
void answer_port_untrunk(Call& call, hxa_ioctl_port_trunk_t& record);
void answer_port_identify(Call& call, hxa_ioctl_port_rnid_t& record);
void answer_port_identification(Call& call, hxa_ioctl_port_rnid_t& record);
void answer_port_statistics(Call& call, hxa_ioctl_port_stats_t& record); // statistics_commands.cpp
void answer_port_reset_statistics(Call& call, hxa_ioctl_gen_t& record);
void answer_fcoe_statistics(Call& call, hxa_ioctl_fcport_stats_t& record);
void answer_fcoe_reset_statistics(Call& call, hxa_ioctl_gen_t& record);
void answer_lport_statistics(Call& call, hxa_ioctl_lport_stats_t& record);
void answer_ethport_attributes(Call& call, hxa_ioctl_ethport_attr_t& record); // ethport_commands.cpp
void answer_ethport_statistics(Call& call, hxa_ioctl_ethport_stats_t& record);
void answer_lport_attributes(Call& call, hxa_ioctl_lport_attr_t& record); // lport_commands.cpp
void answer_lport_reset_statistics(Call& call, hxa_ioctl_lport_reset_stats_t& record);
void answer_lport_remote_ports(Call& call, hxa_ioctl_lport_get_rports_t& record);
void answer_rport_add(Call& call, hxa_ioctl_rport_t& record); // rport_commands.cpp
void answer_rport_remove(Call& call, hxa_ioctl_rport_t& record);
void answer_rport_attributes(Call& call, hxa_ioctl_rport_attr_t& record);
void answer_rport_statistics(Call& call, hxa_ioctl_rport_stats_t& record);
void answer_rport_reset_statistics(Call& call, hxa_ioctl_rport_reset_stats_t& record);
void answer_rport_scsi_address(Call& call, hxa_ioctl_rport_scsi_addr_t& record);
void answer_rport_speed(Call& call, hxa_ioctl_rport_set_speed_t& record);
void answer_nexus_attributes(Call& call, hxa_ioctl_itnim_attr_t& record); // itnim_commands.cpp
void answer_nexus_statistics(Call& call, hxa_ioctl_itnim_stats_t& record);
void answer_nexus_reset_statistics(Call& call, hxa_ioctl_itnim_reset_stats_t& record);
void answer_fc_pass_through(Call& call, hxa_ioctl_fcpt_t& record);        // fcpt_commands.cpp
void answer_flash_attributes(Call& call, hxa_ioctl_flash_attr_t& record); // flash_commands.cpp
void answer_flash_erase(Call& call, hxa_ioctl_flash_t& record);
void answer_flash_update(Call& call, hxa_ioctl_flash_t& record);
void answer_flash_read(Call& call, hxa_ioctl_flash_t& record);
void answer_flash_manufacturing(Call& call, hxa_ioctl_flash_mfg_t& record);
void answer_optrom_enable(Call& call, hxa_ioctl_gen_t& record);
void answer_optrom_disable(Call& call, hxa_ioctl_gen_t& record);

} // namespace hxasim
