/* A provider module written against the CMPI headers alone. Its instances:
 *
 *   TST_Disk     disk0, disk1 ...
 *   TST_Tape     tape0, whose Speed is the number of disks as an up-call counts them, and disk0 once more,
 *                which it fetches from the server
 *   TST_Link     any: getInstance answers an instance with the path it was asked for; Name is that path's text
 *   TST_Failing  none: enumerations fail with ACCESS_DENIED and a message, getInstance with the code that the Id spells
 */
#include "test_module.h"

#include <cmpift.h>
#include <cmpimacs.h>

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#define EXPORT __attribute__((visibility("default")))

static const CMPIBroker* _Atomic broker; /* the factories of all classes set it, on any thread */
static struct Test_Module_State state = {3, 0, CMPI_RC_OK};

EXPORT struct Test_Module_State* test_module_state(void);
struct Test_Module_State* test_module_state(void) { return &state; }

static CMPIStatus rc(CMPIrc code)
{
    CMPIStatus status = {code, NULL};
    return status;
}

/* Its Id is "<prefix><n>". */
static CMPIObjectPath* path_of(const char* class_name, const char* prefix, int n)
{
    CMPIObjectPath* path = CMNewObjectPath(broker, "root/zemlar", class_name, NULL);
    char id[64];
    snprintf(id, sizeof(id), "%s%d", prefix, n);
    CMAddKey(path, "Id", id, CMPI_chars);
    return path;
}

static CMPIInstance* instance_of(CMPIObjectPath* path, const char** properties)
{
    static const char* keys[] = {"Id", NULL};
    CMPIInstance* instance = CMNewInstance(broker, path, NULL);
    CMPIData id = CMGetKey(path, "Id", NULL);
    if (properties)
        CMSetPropertyFilter(instance, properties, keys);
    CMSetProperty(instance, "Id", &id.value, CMPI_string);
    return instance;
}

static CMPIInstance* tape(const CMPIContext* context, const char** properties)
{
    CMPIInstance* instance = instance_of(path_of("TST_Tape", "tape", 0), properties);
    CMPIEnumeration* disks =
        broker->bft->enumerateInstances(broker, context, CMNewObjectPath(broker, "root/zemlar", "TST_Disk", NULL), NULL, NULL);
    CMPIUint32 count = 0;
    for (; disks && CMHasNext(disks, NULL); ++count)
        CMGetNext(disks, NULL);
    CMSetProperty(instance, "Speed", &count, CMPI_uint32);
    return instance;
}

/* ---- TST_Disk ---- */

static CMPIStatus disk_names(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path)
{
    (void)mi, (void)context, (void)path;
    for (int n = 0; n < state.disks; ++n)
        CMReturnObjectPath(result, path_of("TST_Disk", "disk", n));
    return CMReturnDone(result);
}

static CMPIStatus disk_instances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                 const CMPIObjectPath* path, const char** properties)
{
    (void)mi, (void)context, (void)path;
    for (int n = 0; n < state.disks; ++n)
        CMReturnInstance(result, instance_of(path_of("TST_Disk", "disk", n), properties));
    return CMReturnDone(result);
}

static CMPIStatus disk_get(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path,
                           const char** properties)
{
    (void)mi, (void)context;
    const char* id = CMGetCharsPtr(CMGetKey(path, "Id", NULL).value.string, NULL);
    int n = strncmp(id, "disk", 4) == 0 ? atoi(id + 4) : state.disks;
    if (n >= state.disks)
        return rc(CMPI_RC_ERR_NOT_FOUND);
    CMReturnInstance(result, instance_of(path_of("TST_Disk", "disk", n), properties));
    return CMReturnDone(result);
}

/* ---- TST_Tape ---- */

static CMPIStatus tape_names(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path)
{
    (void)mi, (void)context, (void)path;
    CMReturnObjectPath(result, path_of("TST_Tape", "tape", 0));
    CMReturnObjectPath(result, path_of("tst_disk", "disk", 0));
    return rc(CMPI_RC_OK);
}

static CMPIStatus tape_instances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                 const CMPIObjectPath* path, const char** properties)
{
    (void)mi, (void)path;
    CMReturnInstance(result, tape(context, properties));
    CMReturnInstance(result, broker->bft->getInstance(broker, context, path_of("TST_Disk", "disk", 0), properties, NULL));
    return CMReturnDone(result);
}

/* Answers OK, with a result for tape0 only. */
static CMPIStatus tape_get(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path,
                           const char** properties)
{
    (void)mi;
    if (strcmp(CMGetCharsPtr(CMGetKey(path, "Id", NULL).value.string, NULL), "tape0") == 0)
        CMReturnInstance(result, tape(context, properties));
    return CMReturnDone(result);
}

/* ---- TST_Link ---- */

static CMPIStatus link_get(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* path,
                           const char** properties)
{
    (void)mi, (void)context, (void)properties;
    CMPIInstance* instance = CMNewInstance(broker, path, NULL);
    CMPIString* text = path->ft->toString(path, NULL);
    CMSetProperty(instance, "Name", &text, CMPI_string);
    CMReturnInstance(result, instance);
    return CMReturnDone(result);
}

/* ---- TST_Failing ---- */

static CMPIStatus denied(void)
{
    CMPIStatus status = {CMPI_RC_ERR_ACCESS_DENIED, CMNewString(broker, "the door is shut", NULL)};
    return status;
}

static CMPIStatus failing_names(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                const CMPIObjectPath* path)
{
    (void)mi, (void)context, (void)result, (void)path;
    return denied();
}

static CMPIStatus failing_instances(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                                    const CMPIObjectPath* path, const char** properties)
{
    (void)mi, (void)context, (void)result, (void)path, (void)properties;
    return denied();
}

static CMPIStatus failing_get(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
                              const CMPIObjectPath* path, const char** properties)
{
    (void)mi, (void)context, (void)result, (void)properties;
    return rc((CMPIrc)atoi(CMGetCharsPtr(CMGetKey(path, "Id", NULL).value.string, NULL)));
}

/* ---- the interfaces ---- */

static CMPIStatus cleanup(CMPIInstanceMI* mi, const CMPIContext* context, CMPIBoolean terminating)
{
    (void)mi, (void)context;
    if (terminating)
        __atomic_sub_fetch(&state.live_interfaces, 1, __ATOMIC_SEQ_CST);
    return rc((CMPIrc)state.cleanup_rc);
}

static CMPIInstanceMI* made(const CMPIBroker* creator, CMPIInstanceMI* mi)
{
    broker = creator;
    __atomic_add_fetch(&state.live_interfaces, 1, __ATOMIC_SEQ_CST);
    return mi;
}

#define INSTANCE_MI(class_name, names, instances, get)                                                                           \
    EXPORT CMPIInstanceMI* class_name##_Provider_Create_InstanceMI(const CMPIBroker*, const CMPIContext*, CMPIStatus*);          \
    CMPIInstanceMI* class_name##_Provider_Create_InstanceMI(const CMPIBroker* creator, const CMPIContext* context,               \
                                                            CMPIStatus* status)                                                  \
    {                                                                                                                            \
        static const CMPIInstanceMIFT table = {.ftVersion = 100,                                                                 \
                                               .miVersion = 100,                                                                 \
                                               .miName = "instance" #class_name,                                                 \
                                               .cleanup = cleanup,                                                               \
                                               .enumerateInstanceNames = names,                                                  \
                                               .enumerateInstances = instances,                                                  \
                                               .getInstance = get};                                                              \
        static CMPIInstanceMI mi = {NULL, &table};                                                                               \
        (void)context, (void)status;                                                                                             \
        return made(creator, &mi);                                                                                               \
    }

INSTANCE_MI(TST_Disk, disk_names, disk_instances, disk_get)
INSTANCE_MI(TST_Tape, tape_names, tape_instances, tape_get)
INSTANCE_MI(TST_Link, NULL, NULL, link_get)
INSTANCE_MI(TST_Failing, failing_names, failing_instances, failing_get)
