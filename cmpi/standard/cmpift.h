/* The function tables of CMPI 1.00: what a broker offers, what its objects can do, and what a provider offers.
 *
 * The order of the members is the binary contract; every table but CMPIBrokerFT begins with its version. Functions that
 * take a CMPIStatus* as last argument report through it (it may be null); the others return the status. */
#pragma once

#include <cmpidt.h>

#include <stddef.h>

#ifdef __cplusplus
extern "C"
{
#endif

    struct timespec;

    /* ---- the broker ---- */

    struct _CMPIBrokerFT
    {
        CMPIUint32 brokerCapabilities;
        CMPIUint32 brokerVersion;
        const char* brokerName;

        CMPIContext* (*prepareAttachThread)(const CMPIBroker*, const CMPIContext*);
        CMPIStatus (*attachThread)(const CMPIBroker*, const CMPIContext*);
        CMPIStatus (*detachThread)(const CMPIBroker*, const CMPIContext*);
        CMPIStatus (*deliverIndication)(const CMPIBroker*, const CMPIContext*, const char* nameSpace, const CMPIInstance*);
        CMPIEnumeration* (*enumerateInstanceNames)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, CMPIStatus*);
        CMPIInstance* (*getInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char** properties,
                                     CMPIStatus*);
        CMPIObjectPath* (*createInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const CMPIInstance*,
                                          CMPIStatus*);
        CMPIStatus (*modifyInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const CMPIInstance*,
                                     const char** properties);
        CMPIStatus (*deleteInstance)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*);
        CMPIEnumeration* (*execQuery)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* query,
                                      const char* language, CMPIStatus*);
        CMPIEnumeration* (*enumerateInstances)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                                               const char** properties, CMPIStatus*);
        CMPIEnumeration* (*associators)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* assocClass,
                                        const char* resultClass, const char* role, const char* resultRole,
                                        const char** properties, CMPIStatus*);
        CMPIEnumeration* (*associatorNames)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* assocClass,
                                            const char* resultClass, const char* role, const char* resultRole, CMPIStatus*);
        CMPIEnumeration* (*references)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* resultClass,
                                       const char* role, const char** properties, CMPIStatus*);
        CMPIEnumeration* (*referenceNames)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* resultClass,
                                           const char* role, CMPIStatus*);
        CMPIData (*invokeMethod)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* method,
                                 const CMPIArgs* in, CMPIArgs* out, CMPIStatus*);
        CMPIStatus (*setProperty)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* name,
                                  const CMPIValue*, CMPIType);
        CMPIData (*getProperty)(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char* name, CMPIStatus*);
    };
    static_assert(sizeof(CMPIBrokerFT) == 160, "layout of CMPIBrokerFT");

    /* Makes and examines the objects that travel between broker and provider. */
    struct _CMPIBrokerEncFT
    {
        int ftVersion;
        CMPIInstance* (*newInstance)(const CMPIBroker*, const CMPIObjectPath*, CMPIStatus*);
        CMPIObjectPath* (*newObjectPath)(const CMPIBroker*, const char* nameSpace, const char* className, CMPIStatus*);
        CMPIArgs* (*newArgs)(const CMPIBroker*, CMPIStatus*);
        CMPIString* (*newString)(const CMPIBroker*, const char*, CMPIStatus*);
        CMPIArray* (*newArray)(const CMPIBroker*, CMPICount size, CMPIType elementType, CMPIStatus*);
        CMPIDateTime* (*newDateTime)(const CMPIBroker*, CMPIStatus*);
        CMPIDateTime* (*newDateTimeFromBinary)(const CMPIBroker*, CMPIUint64 usec, CMPIBoolean interval, CMPIStatus*);
        CMPIDateTime* (*newDateTimeFromChars)(const CMPIBroker*, const char*, CMPIStatus*);
        CMPISelectExp* (*newSelectExp)(const CMPIBroker*, const char* query, const char* language, CMPIArray** projection,
                                       CMPIStatus*);
        CMPIBoolean (*classPathIsA)(const CMPIBroker*, const CMPIObjectPath*, const char* className, CMPIStatus*);
        CMPIString* (*toString)(const CMPIBroker*, const void* object, CMPIStatus*);
        CMPIBoolean (*isOfType)(const CMPIBroker*, const void* object, const char* type, CMPIStatus*);
        CMPIString* (*getType)(const CMPIBroker*, const void* object, CMPIStatus*);
        CMPIString* (*getMessage)(const CMPIBroker*, const char* id, const char* defaultText, CMPIStatus*, CMPICount, ...);
        CMPIStatus (*logMessage)(const CMPIBroker*, int severity, const char* id, const char* text, const CMPIString*);
        CMPIStatus (*trace)(const CMPIBroker*, int level, const char* component, const char* text, const CMPIString*);
    };
    static_assert(sizeof(CMPIBrokerEncFT) == 136, "layout of CMPIBrokerEncFT");

    /* System services. Those that return int answer 0 or an errno value. */
    struct _CMPIBrokerExtFT
    {
        int ftVersion;
        char* (*resolveFileName)(const char*);
        CMPI_THREAD_TYPE (*newThread)(CMPI_THREAD_RETURN (*start)(void*), void* parameter, int detached);
        int (*joinThread)(CMPI_THREAD_TYPE, CMPI_THREAD_RETURN*);
        int (*exitThread)(CMPI_THREAD_RETURN);
        int (*cancelThread)(CMPI_THREAD_TYPE);
        int (*threadSleep)(CMPIUint32 msec);
        int (*threadOnce)(int* once, void (*init)(void));
        int (*createThreadKey)(CMPI_THREAD_KEY_TYPE*, void (*cleanup)(void*));
        int (*destroyThreadKey)(CMPI_THREAD_KEY_TYPE);
        void* (*getThreadSpecific)(CMPI_THREAD_KEY_TYPE);
        int (*setThreadSpecific)(CMPI_THREAD_KEY_TYPE, void*);
        CMPI_MUTEX_TYPE (*newMutex)(int options);
        void (*destroyMutex)(CMPI_MUTEX_TYPE);
        void (*lockMutex)(CMPI_MUTEX_TYPE);
        void (*unlockMutex)(CMPI_MUTEX_TYPE);
        CMPI_COND_TYPE (*newCondition)(int options);
        void (*destroyCondition)(CMPI_COND_TYPE);
        int (*condWait)(CMPI_COND_TYPE, CMPI_MUTEX_TYPE);
        int (*timedCondWait)(CMPI_COND_TYPE, CMPI_MUTEX_TYPE, struct timespec*);
        int (*signalCondition)(CMPI_COND_TYPE);
    };
    static_assert(sizeof(CMPIBrokerExtFT) == 168, "layout of CMPIBrokerExtFT");

    struct _CMPIBroker
    {
        void* hdl;
        const CMPIBrokerFT* bft;
        const CMPIBrokerEncFT* eft;
        const CMPIBrokerExtFT* xft;
    };
    static_assert(sizeof(CMPIBroker) == 32, "layout of CMPIBroker");

    /* ---- objects ---- */

    struct _CMPIContextFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIContext*);
        CMPIContext* (*clone)(const CMPIContext*, CMPIStatus*);
        CMPIData (*getEntry)(const CMPIContext*, const char* name, CMPIStatus*);
        CMPIData (*getEntryAt)(const CMPIContext*, CMPICount index, CMPIString** name, CMPIStatus*);
        CMPICount (*getEntryCount)(const CMPIContext*, CMPIStatus*);
        CMPIStatus (*addEntry)(const CMPIContext*, const char* name, const CMPIValue*, CMPIType);
    };
    static_assert(sizeof(CMPIContextFT) == 56, "layout of CMPIContextFT");

    struct _CMPIContext
    {
        void* hdl;
        const CMPIContextFT* ft;
    };

    struct _CMPIResultFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIResult*);
        CMPIResult* (*clone)(const CMPIResult*, CMPIStatus*);
        CMPIStatus (*returnData)(const CMPIResult*, const CMPIValue*, CMPIType);
        CMPIStatus (*returnInstance)(const CMPIResult*, const CMPIInstance*);
        CMPIStatus (*returnObjectPath)(const CMPIResult*, const CMPIObjectPath*);
        CMPIStatus (*returnDone)(const CMPIResult*);
    };
    static_assert(sizeof(CMPIResultFT) == 56, "layout of CMPIResultFT");

    struct _CMPIResult
    {
        void* hdl;
        const CMPIResultFT* ft;
    };

    struct _CMPIInstanceFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIInstance*);
        CMPIInstance* (*clone)(const CMPIInstance*, CMPIStatus*);
        CMPIData (*getProperty)(const CMPIInstance*, const char* name, CMPIStatus*);
        CMPIData (*getPropertyAt)(const CMPIInstance*, CMPICount index, CMPIString** name, CMPIStatus*);
        CMPICount (*getPropertyCount)(const CMPIInstance*, CMPIStatus*);
        CMPIStatus (*setProperty)(const CMPIInstance*, const char* name, const CMPIValue*, CMPIType);
        CMPIObjectPath* (*getObjectPath)(const CMPIInstance*, CMPIStatus*);
        CMPIStatus (*setPropertyFilter)(CMPIInstance*, const char** properties, const char** keys);
        CMPIStatus (*setObjectPath)(CMPIInstance*, const CMPIObjectPath*);
    };
    static_assert(sizeof(CMPIInstanceFT) == 80, "layout of CMPIInstanceFT");

    struct _CMPIInstance
    {
        void* hdl;
        const CMPIInstanceFT* ft;
    };

    struct _CMPIObjectPathFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIObjectPath*);
        CMPIObjectPath* (*clone)(const CMPIObjectPath*, CMPIStatus*);
        CMPIStatus (*setNameSpace)(CMPIObjectPath*, const char*);
        CMPIString* (*getNameSpace)(const CMPIObjectPath*, CMPIStatus*);
        CMPIStatus (*setHostname)(CMPIObjectPath*, const char*);
        CMPIString* (*getHostname)(const CMPIObjectPath*, CMPIStatus*);
        CMPIStatus (*setClassName)(CMPIObjectPath*, const char*);
        CMPIString* (*getClassName)(const CMPIObjectPath*, CMPIStatus*);
        CMPIStatus (*addKey)(CMPIObjectPath*, const char* name, const CMPIValue*, CMPIType);
        CMPIData (*getKey)(const CMPIObjectPath*, const char* name, CMPIStatus*);
        CMPIData (*getKeyAt)(const CMPIObjectPath*, CMPICount index, CMPIString** name, CMPIStatus*);
        CMPICount (*getKeyCount)(const CMPIObjectPath*, CMPIStatus*);
        CMPIStatus (*setNameSpaceFromObjectPath)(CMPIObjectPath*, const CMPIObjectPath* source);
        CMPIStatus (*setHostAndNameSpaceFromObjectPath)(CMPIObjectPath*, const CMPIObjectPath* source);
        CMPIData (*getClassQualifier)(const CMPIObjectPath*, const char* qualifier, CMPIStatus*);
        CMPIData (*getPropertyQualifier)(const CMPIObjectPath*, const char* property, const char* qualifier, CMPIStatus*);
        CMPIData (*getMethodQualifier)(const CMPIObjectPath*, const char* method, const char* qualifier, CMPIStatus*);
        CMPIData (*getParameterQualifier)(const CMPIObjectPath*, const char* method, const char* parameter, const char* qualifier,
                                          CMPIStatus*);
        CMPIString* (*toString)(const CMPIObjectPath*, CMPIStatus*);
    };
    static_assert(sizeof(CMPIObjectPathFT) == 160, "layout of CMPIObjectPathFT");

    struct _CMPIObjectPath
    {
        void* hdl;
        const CMPIObjectPathFT* ft;
    };

    struct _CMPIArgsFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIArgs*);
        CMPIArgs* (*clone)(const CMPIArgs*, CMPIStatus*);
        CMPIStatus (*addArg)(const CMPIArgs*, const char* name, const CMPIValue*, CMPIType);
        CMPIData (*getArg)(const CMPIArgs*, const char* name, CMPIStatus*);
        CMPIData (*getArgAt)(const CMPIArgs*, CMPICount index, CMPIString** name, CMPIStatus*);
        CMPICount (*getArgCount)(const CMPIArgs*, CMPIStatus*);
    };
    static_assert(sizeof(CMPIArgsFT) == 56, "layout of CMPIArgsFT");

    struct _CMPIArgs
    {
        void* hdl;
        const CMPIArgsFT* ft;
    };

    struct _CMPIStringFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIString*);
        CMPIString* (*clone)(const CMPIString*, CMPIStatus*);
        const char* (*getCharPtr)(const CMPIString*, CMPIStatus*);
    };
    static_assert(sizeof(CMPIStringFT) == 32, "layout of CMPIStringFT");

    struct _CMPIString
    {
        void* hdl;
        const CMPIStringFT* ft;
    };

    struct _CMPIArrayFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIArray*);
        CMPIArray* (*clone)(const CMPIArray*, CMPIStatus*);
        CMPICount (*getSize)(const CMPIArray*, CMPIStatus*);
        CMPIType (*getSimpleType)(const CMPIArray*, CMPIStatus*);
        CMPIData (*getElementAt)(const CMPIArray*, CMPICount index, CMPIStatus*);
        CMPIStatus (*setElementAt)(CMPIArray*, CMPICount index, const CMPIValue*, CMPIType);
    };
    static_assert(sizeof(CMPIArrayFT) == 56, "layout of CMPIArrayFT");

    struct _CMPIArray
    {
        void* hdl;
        const CMPIArrayFT* ft;
    };

    struct _CMPIEnumerationFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIEnumeration*);
        CMPIEnumeration* (*clone)(const CMPIEnumeration*, CMPIStatus*);
        CMPIData (*getNext)(const CMPIEnumeration*, CMPIStatus*);
        CMPIBoolean (*hasNext)(const CMPIEnumeration*, CMPIStatus*);
        CMPIArray* (*toArray)(const CMPIEnumeration*, CMPIStatus*);
    };
    static_assert(sizeof(CMPIEnumerationFT) == 48, "layout of CMPIEnumerationFT");

    struct _CMPIEnumeration
    {
        void* hdl;
        const CMPIEnumerationFT* ft;
    };

    struct _CMPIDateTimeFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIDateTime*);
        CMPIDateTime* (*clone)(const CMPIDateTime*, CMPIStatus*);
        CMPIUint64 (*getBinaryFormat)(const CMPIDateTime*, CMPIStatus*); /* microseconds */
        CMPIString* (*getStringFormat)(const CMPIDateTime*, CMPIStatus*);
        CMPIBoolean (*isInterval)(const CMPIDateTime*, CMPIStatus*);
    };
    static_assert(sizeof(CMPIDateTimeFT) == 48, "layout of CMPIDateTimeFT");

    struct _CMPIDateTime
    {
        void* hdl;
        const CMPIDateTimeFT* ft;
    };

    /* ---- select expressions ---- */

    struct _CMPISelectExpFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPISelectExp*);
        CMPISelectExp* (*clone)(const CMPISelectExp*, CMPIStatus*);
        CMPIBoolean (*evaluate)(const CMPISelectExp*, const CMPIInstance*, CMPIStatus*);
        CMPIString* (*getString)(const CMPISelectExp*, CMPIStatus*);
        CMPISelectCond* (*getDOC)(const CMPISelectExp*, CMPIStatus*);
        CMPISelectCond* (*getCOD)(const CMPISelectExp*, CMPIStatus*);
        CMPIBoolean (*evaluateUsingAccessor)(const CMPISelectExp*, CMPIAccessor*, void* parameter, CMPIStatus*);
    };
    static_assert(sizeof(CMPISelectExpFT) == 64, "layout of CMPISelectExpFT");

    struct _CMPISelectExp
    {
        void* hdl;
        const CMPISelectExpFT* ft;
    };

    struct _CMPISelectCondFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPISelectCond*);
        CMPISelectCond* (*clone)(const CMPISelectCond*, CMPIStatus*);
        CMPICount (*getCountAndType)(const CMPISelectCond*, int* type, CMPIStatus*);
        CMPISubCond* (*getSubCondAt)(const CMPISelectCond*, CMPICount index, CMPIStatus*);
    };
    static_assert(sizeof(CMPISelectCondFT) == 40, "layout of CMPISelectCondFT");

    struct _CMPISelectCond
    {
        void* hdl;
        const CMPISelectCondFT* ft;
    };

    struct _CMPISubCondFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPISubCond*);
        CMPISubCond* (*clone)(const CMPISubCond*, CMPIStatus*);
        CMPICount (*getCount)(const CMPISubCond*, CMPIStatus*);
        CMPIPredicate* (*getPredicateAt)(const CMPISubCond*, CMPICount index, CMPIStatus*);
        CMPIPredicate* (*getPredicate)(const CMPISubCond*, const char* name, CMPIStatus*);
    };
    static_assert(sizeof(CMPISubCondFT) == 48, "layout of CMPISubCondFT");

    struct _CMPISubCond
    {
        void* hdl;
        const CMPISubCondFT* ft;
    };

    struct _CMPIPredicateFT
    {
        int ftVersion;
        CMPIStatus (*release)(CMPIPredicate*);
        CMPIPredicate* (*clone)(const CMPIPredicate*, CMPIStatus*);
        CMPIStatus (*getData)(const CMPIPredicate*, CMPIType*, CMPIPredOp*, CMPIString** left, CMPIString** right);
        CMPIBoolean (*evaluateUsingAccessor)(const CMPIPredicate*, CMPIAccessor*, void* parameter, CMPIStatus*);
    };
    static_assert(sizeof(CMPIPredicateFT) == 40, "layout of CMPIPredicateFT");

    struct _CMPIPredicate
    {
        void* hdl;
        const CMPIPredicateFT* ft;
    };

    /* ---- management interfaces: what a provider offers ---- */

    struct _CMPIInstanceMIFT
    {
        int ftVersion;
        int miVersion;
        const char* miName;
        CMPIStatus (*cleanup)(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean terminating);
        CMPIStatus (*enumerateInstanceNames)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*);
        CMPIStatus (*enumerateInstances)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                         const char** properties);
        CMPIStatus (*getInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                  const char** properties);
        CMPIStatus (*createInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const CMPIInstance*);
        CMPIStatus (*modifyInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const CMPIInstance*, const char** properties);
        CMPIStatus (*deleteInstance)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*);
        CMPIStatus (*execQuery)(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const char* query,
                                const char* language);
    };
    static_assert(sizeof(CMPIInstanceMIFT) == 80, "layout of CMPIInstanceMIFT");

    struct _CMPIInstanceMI
    {
        void* hdl;
        const CMPIInstanceMIFT* ft;
    };

    struct _CMPIAssociationMIFT
    {
        int ftVersion;
        int miVersion;
        const char* miName;
        CMPIStatus (*cleanup)(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean terminating);
        CMPIStatus (*associators)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                  const char* assocClass, const char* resultClass, const char* role, const char* resultRole,
                                  const char** properties);
        CMPIStatus (*associatorNames)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                      const char* assocClass, const char* resultClass, const char* role, const char* resultRole);
        CMPIStatus (*references)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                 const char* resultClass, const char* role, const char** properties);
        CMPIStatus (*referenceNames)(CMPIAssociationMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                     const char* resultClass, const char* role);
    };
    static_assert(sizeof(CMPIAssociationMIFT) == 56, "layout of CMPIAssociationMIFT");

    struct _CMPIAssociationMI
    {
        void* hdl;
        const CMPIAssociationMIFT* ft;
    };

    struct _CMPIMethodMIFT
    {
        int ftVersion;
        int miVersion;
        const char* miName;
        CMPIStatus (*cleanup)(CMPIMethodMI*, const CMPIContext*, CMPIBoolean terminating);
        CMPIStatus (*invokeMethod)(CMPIMethodMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                   const char* method, const CMPIArgs* in, CMPIArgs* out);
    };
    static_assert(sizeof(CMPIMethodMIFT) == 32, "layout of CMPIMethodMIFT");

    struct _CMPIMethodMI
    {
        void* hdl;
        const CMPIMethodMIFT* ft;
    };

    struct _CMPIIndicationMIFT
    {
        int ftVersion;
        int miVersion;
        const char* miName;
        CMPIStatus (*cleanup)(CMPIIndicationMI*, const CMPIContext*, CMPIBoolean terminating);
        CMPIStatus (*authorizeFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char* className,
                                      const CMPIObjectPath*, const char* owner);
        CMPIStatus (*mustPoll)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char* className,
                               const CMPIObjectPath*);
        CMPIStatus (*activateFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char* className,
                                     const CMPIObjectPath*, CMPIBoolean first);
        CMPIStatus (*deActivateFilter)(CMPIIndicationMI*, const CMPIContext*, const CMPISelectExp*, const char* className,
                                       const CMPIObjectPath*, CMPIBoolean last);
        CMPIStatus (*enableIndications)(CMPIIndicationMI*, const CMPIContext*);
        CMPIStatus (*disableIndications)(CMPIIndicationMI*, const CMPIContext*);
    };
    static_assert(sizeof(CMPIIndicationMIFT) == 72, "layout of CMPIIndicationMIFT");

    struct _CMPIIndicationMI
    {
        void* hdl;
        const CMPIIndicationMIFT* ft;
    };

#ifdef __cplusplus
}
#endif
