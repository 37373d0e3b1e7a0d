// Diagnostics of one IOC and of the port behind it.
//
// Every call but hxal_diag_beacon_lport() is one request at most, on the handle's own node; a call that needs the card out of
// service, or in it, is refused by the driver, which also lets one test run at a time on an IOC (HXA_STATUS_DIAG_BUSY). A null
// output is allowed: then only the status comes back. What an output holds after a request that did not fail is what the driver
// left there, also when the status is not HXA_STATUS_OK: that is how a failed test tells what it found.
#pragma once

#include "hxal/ioc.h"
#include "hxal/records/diag.h"
#include "hxal/records/sfp.h"

#ifdef __cplusplus
extern "C"
{
#endif

    // Read `nwords` 32-bit registers of the card from `off` on into `buffer`, which the driver fills directly, and write one.
    // HXA_STATUS_EINVAL, without a request, for a negative count and for a null buffer.
    hxa_status_t hxal_diag_regread(const hxal_t* ioc, uint32_t off, int nwords, void* buffer);
    hxa_status_t hxal_diag_regwrite(const hxal_t* ioc, uint32_t off, uint32_t word);

    // Reads the card's temperature sensor: a number of the driver's, which does not say its unit.
    hxa_status_t hxal_diag_tsensor_query(const hxal_t* ioc, uint16_t* tsensor);

    // No driver offers the power-on self test or the optical monitoring: HXA_STATUS_CMD_NOTSUPP, always, without a request.
    hxa_status_t hxal_diag_post(const hxal_t* ioc, void* result);
    hxa_status_t hxal_diag_pom_query(const hxal_t* ioc, void* pom);

    // Tests the card's memory with the pattern `pat`. All IOCs of the card have to be disabled (HXA_STATUS_ADAPTER_ENABLED). It
    // may take a few moments. HXA_STATUS_MEMTEST_FAILED: see the result.
    hxa_status_t hxal_diag_memtest(const hxal_t* ioc, uint32_t pat, hxa_diag_memtest_result_t* result);

    // Sends `lpcnt` frames of the pattern `pat` from the port to itself. The port has to be disabled
    // (HXA_STATUS_PORT_NOT_DISABLED). `opmode` (hxa_pport_opmode_t) is HXA_PPORT_OPMODE_LB_INT, _LB_EXT or _LB_CBL, and for an
    // Ethernet function one of the last two: anything else is HXA_STATUS_CMD_NOTSUPP without a request. A `speed`
    // (hxa_pport_speed_t) above HXA_PPORT_SPEED_AUTO is HXA_STATUS_EINVAL without a request.
    hxa_status_t hxal_diag_loopback(const hxal_t* ioc, uint32_t opmode, uint32_t speed, uint32_t lpcnt, uint32_t pat,
                                    hxa_diag_loopback_result_t* result);
    hxa_status_t hxal_diag_eth_loopback(const hxal_t* ioc, uint32_t opmode, uint32_t lpcnt, uint32_t pat,
                                        hxa_diag_loopback_result_t* result);

    // Asks whether a loopback test holds the port: HXA_STATUS_OK when none does.
    hxa_status_t hxal_diag_get_lb_status(const hxal_t* ioc);

    // Sends `pattern` through the host's bus to the firmware and back, `cnt` times.
    hxa_status_t hxal_diag_fwping(const hxal_t* ioc, uint32_t cnt, uint32_t pattern, hxa_diag_fwping_result_t* result);

    // Tests one of the queues between driver and firmware.
    hxa_status_t hxal_diag_queuetest(const hxal_t* ioc, uint32_t queue, hxa_diag_qtest_result_t* result);

    // Reads the memory of the port's transceiver (SFF-8472). HXA_STATUS_NO_SFP_DEV when there is none.
    hxa_status_t hxal_diag_sfp_query(const hxal_t* ioc, sfp_mem_t* sfp);

    // Makes the lights of the port do what `ledtest` says. HXA_STATUS_LEDTEST_OP while another test has them.
    hxa_status_t hxal_diag_led_test(const hxal_t* ioc, const hxa_diag_ledtest_t* ledtest);

    // Turn the beacon of the port on or off, the light by which a person finds it, for `sec` seconds (0: until it is turned
    // off). The second form turns on the light at the other end of the link as well, whatever the state.
    //
    // The first form asks for the port's attributes before it sends, and returns the status of that when it is not
    // HXA_STATUS_OK. Without a second request it refuses:
    //     HXA_STATUS_BEACON_ON   turning on: the port's beacon is on
    //     HXA_STATUS_BEACON_OFF  turning off: the port's beacon is off
    //     HXA_STATUS_LBEACON_ON  the beacon of the whole link is on (comes first when turning on, last when turning off)
    hxa_status_t hxal_diag_beacon_lport(const hxal_t* ioc, hxa_boolean_t beacon, uint32_t sec);
    hxa_status_t hxal_diag_beacon_swport(const hxal_t* ioc, hxa_boolean_t beacon, uint32_t sec);

#ifdef __cplusplus
}
#endif
