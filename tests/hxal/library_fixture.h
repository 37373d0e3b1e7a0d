// A test on a simulated host: the library under test, the drivers behind it, and the check that it sent nothing they refuse.
#pragma once

#include "hxal/hxal.h"
#include "sim/hxasim.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <initializer_list>
#include <string>

// Instances 0 and 1 of both drivers.
inline const std::string one_cna = R"({"adapters": [{"kind": "cna"}]})";

class Simulated_Host : public testing::Test
{
protected:
    Simulated_Host()
    {
        hxasim::set_time_scale(0);
        hxal_libinit(hxa_aen_app_cim);
        hxal_set_last_error(HXA_STATUS_OK);
    }

    ~Simulated_Host() override
    {
        EXPECT_THAT(hxasim::violations(), testing::IsEmpty());
        scan("{}");
        hxasim::unload();
    }

    static void host(const std::string& json) { hxasim::load_text(json); }

    // Loads a host and scans it: the number of adapters. Requests count from here on.
    static int scan(const std::string& json)
    {
        host(json);
        const int count = hxal_adapter_scan();
        hxasim::take_requests();
        return count;
    }

    static void fail(const std::string& command, int error, std::optional<int> instance = {})
    {
        hxasim::inject({.command = command, .instance = instance, .error = error});
    }

    // The driver's record goes out with these bytes in it.
    static void distort(const std::string& command, std::size_t offset, std::vector<std::uint8_t> bytes,
                        std::optional<int> instance = {}, const std::string& node = "/dev/hxa")
    {
        hxasim::inject({.command = command, .node = node, .instance = instance, .answer = {{offset, std::move(bytes)}}});
    }

    static std::vector<std::string> requests()
    {
        std::vector<std::string> names;
        for (const auto& request : hxasim::take_requests())
            names.push_back(request.name);
        return names;
    }
};

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
