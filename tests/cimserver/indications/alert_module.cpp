// A module with one indication class, whose provider writes down the calls it gets and answers what it is told to.
#include "alert_module.h"

#include "cmpi/registration.h"
#include "schema/TST_Alert.h"
#include "schema/TST_Disk.h"

#include <cmpift.h>

using namespace zmlr;

namespace
{

constexpr Registration disk_registration = {"alert_module", "TST_Disk_Provider", nullptr, &TST_Disk::static_meta_class, nullptr};
constexpr Registration registration = {"alert_module", "TST_Alert_Provider", nullptr, &TST_Alert::static_meta_class,
                                       &disk_registration};

test::Recorded_Calls recorded;

CMPIStatus record(const std::string& call)
{
    recorded.calls.push_back(call);
    return {call.starts_with(recorded.failing) && !recorded.failing.empty() ? CMPI_RC_ERR_FAILED : CMPI_RC_OK, nullptr};
}

// "name query class|name space:class"
std::string describe(const std::string& name, const CMPISelectExp* filter, const char* class_name, const CMPIObjectPath* path)
{
    const auto text = [](CMPIString* string) { return std::string(string->ft->getCharPtr(string, nullptr)); };
    return name + " " + text(filter->ft->getString(filter, nullptr)) + " " + class_name + "|" +
           text(path->ft->getNameSpace(path, nullptr)) + ":" + text(path->ft->getClassName(path, nullptr));
}

CMPIStatus cleanup(CMPIIndicationMI*, const CMPIContext*, CMPIBoolean) { return {CMPI_RC_OK, nullptr}; }

CMPIStatus authorize(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp* filter, const char* class_name,
                     const CMPIObjectPath* path, const char* owner)
{
    return record(describe("authorize", filter, class_name, path) + " " + owner);
}

CMPIStatus must_poll(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp* filter, const char* class_name,
                     const CMPIObjectPath* path)
{
    return record(describe("poll", filter, class_name, path));
}

CMPIStatus activate(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp* filter, const char* class_name,
                    const CMPIObjectPath* path, CMPIBoolean first)
{
    return record(describe("activate", filter, class_name, path) + (first ? " first" : ""));
}

CMPIStatus deactivate(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp* filter, const char* class_name,
                      const CMPIObjectPath* path, CMPIBoolean last)
{
    return record(describe("deactivate", filter, class_name, path) + (last ? " last" : ""));
}

CMPIStatus enable(CMPIIndicationMI*, const CMPIContext*) { return record("enable"); }
CMPIStatus disable(CMPIIndicationMI*, const CMPIContext*) { return record("disable"); }

constexpr CMPIIndicationMIFT table = {100,       100,      "TST_Alert", cleanup, authorize,
                                      must_poll, activate, deactivate,  enable,  disable};
CMPIIndicationMI interface = {nullptr, &table};

} // namespace

extern "C"
{
    __attribute__((visibility("default"))) const Registration* cimple_module() { return &registration; }

    __attribute__((visibility("default"))) test::Recorded_Calls* recorded_calls() { return &recorded; }

    __attribute__((visibility("default"))) CMPIIndicationMI*
    TST_Alert_Provider_Create_IndicationMI(const CMPIBroker*, const CMPIContext*, CMPIStatus* status)
    {
        *status = {CMPI_RC_OK, nullptr};
        return &interface;
    }
}
