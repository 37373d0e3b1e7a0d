#include "hxal/diag.h"

#include "hxal/internal/request.h"
#include "hxal/port.h"

#include <endian.h>

namespace
{

bool is_ethernet_loopback(uint32_t opmode) { return opmode == HXA_PPORT_OPMODE_LB_EXT || opmode == HXA_PPORT_OPMODE_LB_CBL; }
bool is_loopback(uint32_t opmode) { return opmode == HXA_PPORT_OPMODE_LB_INT || is_ethernet_loopback(opmode); }

// Why the beacon of a port cannot be turned; HXA_STATUS_OK when it can.
hxa_status_t beacon_refusal(const hxa_pport_attr_t& port, hxa_boolean_t beacon)
{
    if (beacon && port.link_e2e_beacon)
        return HXA_STATUS_LBEACON_ON;
    if (beacon && port.beacon)
        return HXA_STATUS_BEACON_ON;
    if (!beacon && !port.beacon)
        return HXA_STATUS_BEACON_OFF;
    return port.link_e2e_beacon ? HXA_STATUS_LBEACON_ON : HXA_STATUS_OK;
}

hxa_status_t set_beacons(const hxal_t& ioc, hxa_boolean_t beacon, hxa_boolean_t link_e2e_beacon, uint32_t sec)
{
    auto record = hxal::request_for<hxa_ioctl_diag_beacon_t>(ioc);
    record.beacon = beacon;
    record.link_e2e_beacon = link_e2e_beacon;
    record.second = sec;
    return hxal::exchange(ioc, "IOCMD_DIAG_BEACON", record);
}

} // namespace

hxa_status_t hxal_diag_regread(const hxal_t* ioc, uint32_t off, int nwords, void* buffer)
{
    if (!ioc || nwords < 0 || !buffer)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_regread_t>(*ioc);
    record.off = off;
    record.nwords = static_cast<uint32_t>(nwords);
    record.buf_ptr = hxal::sender_address(buffer);
    return hxal::exchange(*ioc, "IOCMD_DIAG_REGREAD", record);
}

hxa_status_t hxal_diag_regwrite(const hxal_t* ioc, uint32_t off, uint32_t word)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_regwrite_t>(*ioc);
    record.off = off;
    record.word = word;
    return hxal::exchange(*ioc, "IOCMD_DIAG_REGWRITE", record);
}

hxa_status_t hxal_diag_tsensor_query(const hxal_t* ioc, uint16_t* tsensor)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_get_temp_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_DIAG_TEMP", record, &hxa_ioctl_diag_get_temp_t::temp, tsensor);
}

hxa_status_t hxal_diag_post(const hxal_t*, void*) { return HXA_STATUS_CMD_NOTSUPP; }
hxa_status_t hxal_diag_pom_query(const hxal_t*, void*) { return HXA_STATUS_CMD_NOTSUPP; }

hxa_status_t hxal_diag_memtest(const hxal_t* ioc, uint32_t pat, hxa_diag_memtest_result_t* result)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_memtest_t>(*ioc);
    record.pat = pat;
    return hxal::exchange(*ioc, "IOCMD_DIAG_MEMTEST", record, &hxa_ioctl_diag_memtest_t::result, result);
}

hxa_status_t hxal_diag_loopback(const hxal_t* ioc, uint32_t opmode, uint32_t speed, uint32_t lpcnt, uint32_t pat,
                                hxa_diag_loopback_result_t* result)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    if (!is_loopback(opmode))
        return HXA_STATUS_CMD_NOTSUPP;
    if (speed > HXA_PPORT_SPEED_AUTO)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_loopback_t>(*ioc);
    record.opmode = opmode;
    record.speed = speed;
    record.lpcnt = htobe32(lpcnt);
    record.pat = htobe32(pat);
    return hxal::exchange(*ioc, "IOCMD_DIAG_LOOPBACK", record, &hxa_ioctl_diag_loopback_t::result, result);
}

hxa_status_t hxal_diag_eth_loopback(const hxal_t* ioc, uint32_t opmode, uint32_t lpcnt, uint32_t pat,
                                    hxa_diag_loopback_result_t* result)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    if (!is_ethernet_loopback(opmode))
        return HXA_STATUS_CMD_NOTSUPP;
    auto record = hxal::request_for<hxa_ioctl_diag_ll_loopback_t>(*ioc);
    record.opmode = opmode;
    record.lpcnt = lpcnt;
    record.pat = pat;
    return hxal::exchange(*ioc, "IOCMD_DIAG_LL_LOOPBACK", record, &hxa_ioctl_diag_ll_loopback_t::result, result);
}

hxa_status_t hxal_diag_get_lb_status(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_lb_stat_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_DIAG_LB_STAT", record);
}

hxa_status_t hxal_diag_fwping(const hxal_t* ioc, uint32_t cnt, uint32_t pattern, hxa_diag_fwping_result_t* result)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_fwping_t>(*ioc);
    record.cnt = cnt;
    record.pattern = pattern;
    return hxal::exchange(*ioc, "IOCMD_DIAG_FWPING", record, &hxa_ioctl_diag_fwping_t::result, result);
}

hxa_status_t hxal_diag_queuetest(const hxal_t* ioc, uint32_t queue, hxa_diag_qtest_result_t* result)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_qtest_t>(*ioc);
    record.queue = queue;
    return hxal::exchange(*ioc, "IOCMD_DIAG_QUEUETEST", record, &hxa_ioctl_diag_qtest_t::result, result);
}

hxa_status_t hxal_diag_sfp_query(const hxal_t* ioc, sfp_mem_t* sfp)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_sfp_show_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_DIAG_SFP", record, &hxa_ioctl_sfp_show_t::sfp, sfp);
}

hxa_status_t hxal_diag_led_test(const hxal_t* ioc, const hxa_diag_ledtest_t* ledtest)
{
    if (!ioc || !ledtest)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_diag_led_t>(*ioc);
    record.ledtest = *ledtest;
    return hxal::exchange(*ioc, "IOCMD_DIAG_LED", record);
}

hxa_status_t hxal_diag_beacon_lport(const hxal_t* ioc, hxa_boolean_t beacon, uint32_t sec)
{
    hxa_pport_attr_t port;
    if (const hxa_status_t read = hxal_port_get_attr(ioc, &port); read != HXA_STATUS_OK)
        return read;
    if (const hxa_status_t refusal = beacon_refusal(port, beacon); refusal != HXA_STATUS_OK)
        return refusal;
    return set_beacons(*ioc, beacon, HXA_FALSE, sec);
}

hxa_status_t hxal_diag_beacon_swport(const hxal_t* ioc, hxa_boolean_t beacon, uint32_t sec)
{
    return ioc ? set_beacons(*ioc, beacon, beacon, sec) : HXA_STATUS_EINVAL;
}
