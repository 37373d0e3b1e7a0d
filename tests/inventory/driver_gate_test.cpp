#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"
#include "inventory/provider_init.h"
#include "inventory/provider_util.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <cstdlib>
#include <map>

using namespace zmlr;
using namespace std::string_literals;
using testing::IsSupersetOf;

namespace
{

// A static object that asks before the probe's own object need have been made.
const Driver_Status asked_early = ProviderInit::getDriverStatus();

// What the probe makes of each host, and the lines it leaves.
struct Probe
{
    Driver_Status status;
    int adapters;
    std::string line;
};

const std::map<std::string, Probe> probes = {
    {"mixed", {DRIVER_GOOD, 4, "INFO ProviderInit: hxal_get_last_error returns Success  "}},
    {"no-adapter", {DRIVER_FAILURE, 0, "INFO ProviderInit: hxal_get_last_error returns Success  "}},
    {"hole",
     {DRIVER_FAILURE, 0,
      "WARN ProviderInit: WARNING: A driver answers, but there are no adapters: it counts more IOCs than it has"}},
    {"no-driver", {DRIVER_MISSING, 0, "ERR ProviderInit: ERROR: No driver found"}},
    {"version-refused", {DRIVER_VERSION_FAIL, 0, "ERR ProviderInit: ERROR: HXAL version mismatch"}},
};

constexpr const char* closed = "Driver is not installed or there is a hxal mismatch hence no instances returned";

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
    EXPECT_EQ(ProviderUtil::getDriverStatus(), open());
    EXPECT_EQ(FCHBAManager::getFCHBAManager().getInstances(CLASSID_PortController).empty(), probe().adapters == 0);
    for (uint32 id = CLASSID_None; id <= MAXCLASSID; id++)
    {
        HDRManager::getHDRManager().getInstances(static_cast<classId_t>(id));
        if (id != CLASSID_PortController)
            FCHBAManager::getFCHBAManager().getInstances(static_cast<classId_t>(id));
    }
    const std::vector<std::string> lines = log();
    EXPECT_THAT(lines, IsSupersetOf({"INFO ProviderInit: hxal_libinit() returned  0 "s,
                                     "DBG ProviderInit: Adapter Count = " + std::to_string(probe().adapters), probe().line,
                                     "INFO FCHBAManager: Inside FCHBAManager Constructor"s,
                                     "INFO HDRManager: Inside HDRManager Constructor"s}));
    EXPECT_EQ(std::count(lines.begin(), lines.end(), "INFO ProviderInit: Inside ProviderInit Constructor."), 1);
    for (const auto& [manager, classes] : {std::pair{"FCHBAManager", 25}, {"HDRManager", 2}}) // all but host and access point
        EXPECT_EQ(std::count(lines.begin(), lines.end(), "ERR "s + manager + ": " + closed), open() ? 0 : classes);
}
