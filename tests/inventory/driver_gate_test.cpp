#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"
#include "inventory/provider_init.h"
#include "inventory/provider_util.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <cstdlib>
#include <map>

using namespace zmlr;
using testing::Contains;
using testing::IsSupersetOf;
using testing::Not;

namespace
{

// A static object that asks before the probe's own object need have been made.
const Driver_Status asked_early = ProviderInit::getDriverStatus();

// What the probe makes of each host, and the lines it leaves.
struct Probe
{
    Driver_Status status;
    std::vector<std::string> log;
};

const std::string libinit = "INFO ProviderInit: hxal_libinit() returned  0 ";
const std::map<std::string, Probe> probes = {
    {"mixed",
     {DRIVER_GOOD, {libinit, "DBG ProviderInit: Adapter Count = 4", "INFO ProviderInit: hxal_get_last_error returns Success  "}}},
    {"no-adapter",
     {DRIVER_FAILURE,
      {libinit, "DBG ProviderInit: Adapter Count = 0", "INFO ProviderInit: hxal_get_last_error returns Success  "}}},
    {"no-driver", {DRIVER_MISSING, {libinit, "DBG ProviderInit: Adapter Count = 0", "ERR ProviderInit: ERROR: No driver found"}}},
    {"version-refused",
     {DRIVER_VERSION_FAIL, {libinit, "DBG ProviderInit: Adapter Count = 0", "ERR ProviderInit: ERROR: HXAL version mismatch"}}},
};

class Driver_Gate : public Inventory_Test
{
protected:
    // The host that the program was loaded on stays.
    void SetUp() override { fake_host = Fake_Host(); }

    static const Probe& probe()
    {
        std::string scenario = std::getenv("HXASIM_SCENARIO");
        scenario = scenario.substr(scenario.rfind('/') + 1);
        return probes.at(scenario.substr(0, scenario.find('.')));
    }
    static bool open() { return probe().status <= DRIVER_FAILURE; }
};

} // namespace

TEST_F(Driver_Gate, is_what_the_probe_found)
{
    EXPECT_EQ(asked_early, probe().status);
    EXPECT_EQ(ProviderInit::getDriverStatus(), probe().status);
    EXPECT_EQ(ProviderUtil::getDriverStatus(), open());
    const std::vector<std::string> lines = log();
    EXPECT_THAT(lines, IsSupersetOf(probe().log));
    EXPECT_EQ(std::count(lines.begin(), lines.end(), "INFO ProviderInit: Inside ProviderInit Constructor."), 1);
}

TEST_F(Driver_Gate, closes_every_class_that_needs_the_adapters)
{
    constexpr const char* closed = "Driver is not installed or there is a hxal mismatch hence no instances returned";
    constexpr const char* unsupported = "Requested class is NOT supported.";
    const auto is = [](uint32 id, auto... any) { return ((id == any) || ...); };

    for (uint32 id = 0; id <= MAXCLASSID + 1; id++)
    {
        const bool in_table = id <= MAXCLASSID && !is(id, 0U, 9U, 10U, 11U, 12U, 13U, 14U, 15U, 16U, 29U);
        const bool needs_driver = in_table && !is(id, 1U, 17U);
        log();
        const Instance_Array instances = FCHBAManager::getFCHBAManager().getInstances(static_cast<classId_t>(id));
        const std::vector<std::string> lines = log();
        EXPECT_EQ(testing::Value(lines, Contains(std::string("ERR FCHBAManager: ") + closed)), needs_driver && !open()) << id;
        EXPECT_EQ(testing::Value(lines, Contains(std::string("INFO FCHBAManager: ") + unsupported)), !in_table) << id;
        EXPECT_EQ(instances.empty(), !is(id, 1U) && !(probe().status == DRIVER_GOOD && is(id, 2U, 3U))) << id;

        const bool storage = is(id, 9U, 16U);
        EXPECT_TRUE(HDRManager::getHDRManager().getInstances(static_cast<classId_t>(id)).empty()) << id;
        const std::vector<std::string> hdr_lines = log();
        EXPECT_EQ(testing::Value(hdr_lines, Contains(std::string("ERR HDRManager: ") + closed)), storage && !open()) << id;
        EXPECT_EQ(testing::Value(hdr_lines, Contains(std::string("INFO HDRManager: ") + unsupported)), !storage) << id;
    }
}
