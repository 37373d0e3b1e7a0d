// Every line of the log that a host can provoke, its level and its text: log.txt.
#include "inventory/adapter_helper.h"
#include "inventory/adapter_software_identity.h"
#include "inventory/beacon.h"
#include "inventory/ethernet_port_helper.h"
#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"
#include "inventory/physical_asset_helper.h"
#include "inventory/port_helper.h"
#include "inventory/storage_instances.h"
#include "providers/enumerations.h"
#include "tests/inventory/inventory_fixture.h"

#include <algorithm>
#include <fstream>
#include <set>
#include <sstream>

using namespace zmlr;

namespace
{

// What no request of a client leads to.
void ask_for_what_there_is_not()
{
    FCHBAManager::getFCHBAManager().getInstances(static_cast<classId_t>(MAXCLASSID + 1));
    HDRManager::getHDRManager().getInstances(CLASSID_FCPort);
    AdapterHelper::getAdapterHelperInstance().getInstancesByClass(CLASSID_None);
    PortHelper::getPortHelperObject().getInstancesByClass(CLASSID_None);
    EthernetPortHelper::getEthernetPortHelperObject().getInstancesByClass(CLASSID_None);
    PhysicalAssetHelper::getPhysicalAssetHelperObject().getInstancesByClass(CLASSID_None);
    getAdapterSoftwareIdentityInstance({}, softwareType_t{}, false);
    _hbaLunInfo lun;
    lun.identifier_type = 4;
    getStorageExtentInstance({}, lun);
    getTapeDriveInstance({}, lun);
}

void ask(const std::string& question)
{
    std::istringstream words(question);
    std::string what, address, gives;
    int state = 0, result = 0;
    words >> what >> address >> state >> gives >> result;
    if (what == "beacon")
    {
        EXPECT_EQ(setAlarmState(address.c_str(), state), result) << question;
        for (const hxasim::Request& request : hxasim::take_requests())
            EXPECT_TRUE(request.name != "IOCMD_DIAG_BEACON" || request.sent[16] == 0) << "a time limit";
    }
    else if (what == "ports")
    {
        FCHBAManager::getFCHBAManager().getFCPortInstancesByAdapter(address.c_str());
        FCHBAManager::getFCHBAManager().getEthernetPortInstancesByAdapter(address.c_str());
    }
    else if (what == "nothing")
        ask_for_what_there_is_not();
    else
        instances_of(*std::ranges::find(enumerations, what, [](const Enumeration& row) { return row.meta_class->name; }), nullptr,
                     what.c_str());
}

using Log = Inventory_Test;

} // namespace

// In the file, "{" begins a host and "-" what is asked of it, of a beacon with its result; behind that stand the lines that were
// not logged before, in bars.
TEST_F(Log, tells_what_happens)
{
    FCHBAManager::getFCHBAManager();
    HDRManager::getHDRManager();
    log();
    std::ifstream file(LOG_FILE);
    std::ostringstream expected;
    expected << file.rdbuf();
    std::istringstream questions(expected.str());
    std::set<std::string> known;
    std::string logged;
    for (std::string line; std::getline(questions, line);)
    {
        if (line.starts_with('|'))
            continue;
        logged += line + '\n';
        if (line.starts_with('{'))
            plug_text(line);
        if (line.starts_with("- "))
            ask(line.substr(2));
        for (const std::string& said : log(true))
            if (known.insert(said).second)
                logged += '|' + said + "|\n";
    }
    EXPECT_EQ(logged, expected.str());
}
