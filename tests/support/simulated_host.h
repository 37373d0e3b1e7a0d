// A test on a simulated host: the drivers, what they were sent, and the check that it was nothing they refuse.
#pragma once

#include "sim/hxasim.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

class Simulated_Host : public testing::Test
{
protected:
    ~Simulated_Host() override
    {
        expect_violations();
        hxasim::unload();
    }

    // Fails on requests that no driver would accept, but for those that the test said it expects, in this order.
    void expect_violations()
    {
        EXPECT_THAT(hxasim::violations(), testing::ElementsAreArray(std::exchange(_expected_violations, {})));
    }
    void expect_violation(const std::string& text) { _expected_violations.push_back(text); }

    static void host(const std::string& json) { hxasim::load_text(json); }

    static void fail(const std::string& command, int error, std::optional<int> instance = {}, const std::string& node = "")
    {
        hxasim::inject({.command = command, .node = node, .instance = instance, .error = error});
    }

    // The driver's record goes out with this status, or with these bytes in it.
    static void answer(const std::string& command, std::uint32_t status, const std::string& node = "",
                       std::optional<int> instance = {})
    {
        hxasim::inject({.command = command, .node = node, .instance = instance, .status = status});
    }
    static void distort(const std::string& command, std::size_t offset, std::vector<std::uint8_t> bytes,
                        std::optional<int> instance = {}, const std::string& node = "/dev/hxa")
    {
        hxasim::inject({.command = command, .node = node, .instance = instance, .answer = {{offset, std::move(bytes)}}});
    }

    // The requests since the last call, as "IOCMD_IOC_GET_INFO /dev/hxa 0", or by their names alone.
    static std::vector<std::string> requests()
    {
        std::vector<std::string> texts;
        for (const auto& request : hxasim::take_requests())
            texts.push_back(request.name + ' ' + request.node + ' ' + std::to_string(request.instance));
        return texts;
    }
    static std::vector<std::string> commands()
    {
        std::vector<std::string> names;
        for (const auto& request : hxasim::take_requests())
            names.push_back(request.name);
        return names;
    }

private:
    std::vector<std::string> _expected_violations;
};
