// A test of the library on a simulated host: its verbs, and the addresses of the simulated product line.
#pragma once

#include "hxal/hxal.h"
#include "tests/support/simulated_host.h"

#include <algorithm>
#include <cstring>
#include <initializer_list>
#include <string>
#include <vector>

// Instances 0 and 1 of both drivers.
inline const std::string one_cna = R"({"adapters": [{"kind": "cna"}]})";

class Library_Test : public Simulated_Host
{
protected:
    Library_Test()
    {
        hxasim::set_time_scale(0);
        hxal_libinit(hxa_aen_app_cim);
        hxal_set_last_error(HXA_STATUS_OK);
    }

    ~Library_Test() override
    {
        expect_violations();
        scan("{}");
    }

    // Loads a host and scans it: the number of adapters. Requests count from here on.
    static int scan(const std::string& json)
    {
        host(json);
        const int count = hxal_adapter_scan();
        hxasim::take_requests();
        return count;
    }
};

// What `work` prints.
template <typename Work> std::string printed_by(Work work)
{
    testing::internal::CaptureStdout();
    work();
    std::fflush(stdout);
    return testing::internal::GetCapturedStdout();
}

// The first bytes of a WWN or of a LUN; the others are 0.
inline wwn_t wwn(std::initializer_list<uint8_t> bytes)
{
    wwn_t value = 0;
    std::copy(bytes.begin(), bytes.end(), reinterpret_cast<uint8_t*>(&value));
    return value;
}
inline lun_t lun(std::initializer_list<uint8_t> bytes) { return wwn(bytes); }

// WWNs and MACs as the simulated product line numbers them.
inline wwn_t port_wwn(uint8_t adapter, uint8_t port) { return wwn({0x10, 0, 0, 0x05, 0x1E, 0x10, adapter, port}); }
inline wwn_t node_wwn(uint8_t adapter, uint8_t port) { return wwn({0x20, 0, 0, 0x05, 0x1E, 0x10, adapter, port}); }

inline mac_t eth_mac(uint8_t adapter, uint8_t port) { return {{0x00, 0x05, 0x1E, 0x20, adapter, port}}; }
inline mac_t fcoe_mac(uint8_t adapter, uint8_t port) { return {{0x00, 0x05, 0x1E, 0x30, adapter, port}}; }
