#include "sim/model/sfp.h"

#include "hxal/records/port.h"

#include <numeric>

namespace hxasim
{

namespace
{

// Bits of the compliance bytes, SFF-8472.
constexpr std::uint8_t ethernet_10g = 0xF0;    // byte 3, all kinds of it
constexpr std::uint8_t ethernet_10g_sr = 0x10; // byte 3
constexpr std::uint8_t shortwave_laser = 0x40; // byte 8
constexpr std::uint8_t multimode_fibre = 0x0C; // byte 9
constexpr std::uint8_t fc_100 = 0x01;          // byte 10, MByte/s
constexpr std::uint8_t fc_200 = 0x04;
constexpr std::uint8_t fc_400 = 0x10;
constexpr std::uint8_t fc_800 = 0x40;
constexpr std::uint8_t fc_1200 = 0x80;

void put_compliance(sfp_serial_id_base_t& id, std::uint32_t speed)
{
    if (speed == HXA_PPORT_SPEED_10GBPS)
    {
        id.xcvr[0] = ethernet_10g_sr;
        id.encoding = 6;
        id.br_norm = 103;
        return;
    }
    id.xcvr[5] = shortwave_laser;
    id.xcvr[6] = multimode_fibre;
    id.xcvr[7] = speed == HXA_PPORT_SPEED_8GBPS ? fc_200 | fc_400 | fc_800 : fc_100 | fc_200 | fc_400;
    id.encoding = 1;
    id.br_norm = speed == HXA_PPORT_SPEED_8GBPS ? 85 : 43;
}

void put_identification(sfp_mem_t& memory, std::uint32_t speed, const std::string& serial)
{
    auto& base = memory.serial_id_base;
    base.identifier = 3;
    base.ext_identifier = 4;
    base.connector = 7;
    put_compliance(base, speed);
    base.len_om2 = 8;
    base.len_om1 = 3;
    base.len_om3 = 30;
    put_padded(base.vendor_name, "ZEMLAR");
    put_padded(base.vendor_pn, speed == HXA_PPORT_SPEED_10GBPS ? "ZM-SFP-10GSR" : "ZM-SFP-FCSW");
    put_padded(base.vendor_rev, "A");
    put_word(base.wavelen, 850);
    auto& extended = memory.serial_id_ext;
    extended.options[1] = 0x1A; // loss of signal, transmitter fault and disable
    put_padded(extended.vendor_sn, serial);
    put_padded(extended.date_code, "100401");
    extended.diag_mon_type = 0x68; // monitors itself, calibrated inside, average power
    extended.en_options = 0xB0;    // alarms and warnings, transmitter fault, loss of signal
    extended.sff_8472 = 3;         // revision 10.2
}

void put_thresholds(sfp_thresholds_t& field, int low_alarm, int low_warning, int high_warning, int high_alarm)
{
    put_word(field.high_alarm, high_alarm);
    put_word(field.low_alarm, low_alarm);
    put_word(field.high_warning, high_warning);
    put_word(field.low_warning, low_warning);
}

// Calibrated inside: what is measured is what it means.
void put_calibration(sfp_diag_base_t& base)
{
    constexpr std::uint8_t float_one[] = {0x3F, 0x80, 0x00, 0x00};
    constexpr int fixed_one = 0x0100;
    std::copy(std::begin(float_one), std::end(float_one), base.cal_rx_power[3]);
    for (auto* line : {&base.cal_bias, &base.cal_tx_power, &base.cal_temperature, &base.cal_voltage})
        put_word(line->slope, fixed_one);
}

void put_monitoring(sfp_mem_t& memory)
{
    auto& base = memory.diag_base;
    put_thresholds(base.temperature, -5 * 256, 0, 70 * 256, 75 * 256);
    put_thresholds(base.voltage, 30000, 31000, 35000, 36000);
    put_thresholds(base.bias, 1000, 1250, 4000, 4250);
    put_thresholds(base.tx_power, 1000, 1260, 7900, 10000);
    put_thresholds(base.rx_power, 100, 160, 7900, 10000);
    put_calibration(base);
    auto& values = memory.diag_ext;
    put_word(values.temperature, 35 * 256 + 128);
    put_word(values.voltage, 33000);
    put_word(values.bias, 3000);
    put_word(values.tx_power, 5000);
    put_word(values.rx_power, 4500);
}

// The low byte of the sum of all bytes of a block but the last, which holds it.
template <typename Block> std::uint8_t checksum(const Block& block)
{
    const auto* first = reinterpret_cast<const std::uint8_t*>(&block);
    return static_cast<std::uint8_t>(std::accumulate(first, first + sizeof(block) - 1, 0));
}

} // namespace

Sfp_Module usual_sfp(std::uint32_t speed, const std::string& serial)
{
    Sfp_Module module;
    put_identification(module.memory, speed, serial);
    put_monitoring(module.memory);
    seal(module.memory);
    return module;
}

void seal(sfp_mem_t& memory)
{
    memory.serial_id_base.cc_base = checksum(memory.serial_id_base);
    memory.serial_id_ext.cc_ext = checksum(memory.serial_id_ext);
    memory.diag_base.cc_dmi = checksum(memory.diag_base);
}

bool supports(const Sfp_Module& module, std::uint32_t speed)
{
    const auto& compliance = module.memory.serial_id_base.xcvr;
    switch (speed)
    {
    case HXA_PPORT_SPEED_1GBPS:
        return (compliance[7] & fc_100) != 0;
    case HXA_PPORT_SPEED_2GBPS:
        return (compliance[7] & fc_200) != 0;
    case HXA_PPORT_SPEED_4GBPS:
        return (compliance[7] & fc_400) != 0;
    case HXA_PPORT_SPEED_8GBPS:
        return (compliance[7] & fc_800) != 0;
    case HXA_PPORT_SPEED_10GBPS:
        return (compliance[0] & ethernet_10g) != 0 || (compliance[7] & fc_1200) != 0;
    default:
        return speed == HXA_PPORT_SPEED_AUTO;
    }
}

} // namespace hxasim
