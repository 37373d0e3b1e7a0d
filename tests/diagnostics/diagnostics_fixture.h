// The module on one simulated host for the whole program: its first run pins it, and it would not look at another host.
#pragma once

#include "cimserver/broker/module.h"
#include "cimserver/interop/name_spaces.h"
#include "sim/hxasim.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

// Of each class the elements in their order: a CNA and an HBA whose first port is in service and whose second one is not; then a
// CNA and an HBA that are disabled as a whole.
inline constexpr std::size_t cna = 0, hba = 1, disabled_cna = 2, disabled_hba = 3;           // ZEMLAR_PortController
inline constexpr std::size_t cna_port = 0, cna_port_out = 1, hba_port = 2, hba_port_out = 3; // ZEMLAR_FCPort, ZEMLAR_EthernetPort

// Whether the module logs, from LL_INFO up: defined by the program.
extern const bool wants_log;

class Diagnostics : public testing::Test
{
protected:
    void SetUp() override;
    void TearDown() override; // fails on requests that no driver would accept

    static std::vector<cimserver::Instance> enumerate(const std::string& class_name);
    static std::string value(const cimserver::Instance& instance, const std::string& property);

    // RunDiagnostic of the test "Zemlar:<name>" on an element: what it returns, and the job's InstanceID ("" without a job).
    struct Answer
    {
        std::string code;
        std::string job;
    };
    static Answer run(const std::string& test_class, const std::string& name, const cimserver::Object_Path& element);
    static cimserver::Object_Path path(const std::string& class_name, std::size_t index);

    static void wait_for_end(); // until the run's thread is gone

    static std::string states(); // of all adapters and ports, as the model tells them
    static std::vector<std::string>
    new_log(); // "LEVEL text" of the diagnostics since the last call, from LL_INFO up, and where a job completes

    static void unload();
    static void load(); // does nothing while it is loaded
};
