// A module with one indication class, whose provider writes down the calls it gets and answers what it is told to.
#include "alert_module.h"

#include "cmpi/registration.h"

#include <cmpift.h>

#include <iterator>

using namespace zmlr;

namespace
{

extern const Meta_Repository repository;

constexpr Meta_Property property(const char* name, Type type, sint16 subscript = 0)
{
    return {{{0}, Flag_Property | Flag_Read, name, nullptr, 0}, static_cast<uint16>(type), subscript, 0, nullptr};
}

constexpr Meta_Property properties[] = {
    property("Text", STRING),    property("Number", SINT64), property("Size", UINT64),      property("Ratio", REAL64),
    property("Urgent", BOOLEAN), property("Time", DATETIME), property("Texts", STRING, -1),
};
constexpr const Meta_Feature* features[] = {&properties[0], &properties[1], &properties[2], &properties[3],
                                            &properties[4], &properties[5], &properties[6]};

constexpr Meta_Class make_class(const char* name, uint32 flags, const Meta_Class* super)
{
    return {{{{0}, Flag_Class | flags, name, nullptr, 0}, features, std::size(features), 0}, nullptr, super, 0, &repository};
}

constexpr Meta_Class event = make_class("TST_Event", Flag_Indication | Flag_Abstract, nullptr);
constexpr Meta_Class alert = make_class("TST_Alert", Flag_Indication, &event);
constexpr Meta_Class disk = make_class("TST_Disk", 0, nullptr);
constexpr const Meta_Class* classes[] = {&event, &alert, &disk};
constexpr Meta_Repository repository = {classes, std::size(classes)};

int no_operation(const Registration*, int, void*, void*, void*, void*, void*, void*, void*, void*) { return -1; }

constexpr Registration disk_registration = {"alert_module", "TST_Disk_Provider", no_operation, &disk, nullptr};
constexpr Registration registration = {"alert_module", "TST_Alert_Provider", no_operation, &alert, &disk_registration};

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
