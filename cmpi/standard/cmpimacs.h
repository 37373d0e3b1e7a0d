/* The calls of CMPI 1.00 by the names its users know: CM* act on objects, CB* call services of the broker.
 *
 * Each is one call through a function table and behaves as that table's function does; `rc` may be null. A parameter
 * `value` is a CMPIValue* or, for CMPI_chars, the text itself. */
#pragma once

#include <cmpift.h>

#include <stdbool.h>

#ifdef __cplusplus
extern "C"
{
#endif

    /* ---- statuses and data ---- */

    static inline void CMSetStatus(CMPIStatus* status, CMPIrc rc)
    {
        if (status)
        {
            status->rc = rc;
            status->msg = NULL;
        }
    }

    static inline void CMSetStatusWithString(CMPIStatus* status, CMPIrc rc, CMPIString* message)
    {
        if (status)
        {
            status->rc = rc;
            status->msg = message;
        }
    }

    static inline bool CMIsNullObject(const void* object) { return object == NULL; }
    static inline bool CMIsNullValue(CMPIData data) { return (data.state & CMPI_nullValue) != 0; }
    static inline bool CMIsKeyValue(CMPIData data) { return (data.state & CMPI_keyValue) != 0; }
    static inline bool CMIsArray(CMPIData data) { return (data.type & CMPI_ARRAY) != 0; }

/* These two work on every kind of object, which takes a macro in C. */
#define CMRelease(object) ((object)->ft->release((object)))
#define CMClone(object, rc) ((object)->ft->clone((object), (rc)))

    /* ---- making and examining objects ---- */

    static inline CMPIInstance* CMNewInstance(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* rc)
    {
        return broker->eft->newInstance(broker, path, rc);
    }

    static inline CMPIObjectPath* CMNewObjectPath(const CMPIBroker* broker, const char* nameSpace, const char* className,
                                                  CMPIStatus* rc)
    {
        return broker->eft->newObjectPath(broker, nameSpace, className, rc);
    }

    static inline CMPIArgs* CMNewArgs(const CMPIBroker* broker, CMPIStatus* rc) { return broker->eft->newArgs(broker, rc); }

    static inline CMPIString* CMNewString(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
    {
        return broker->eft->newString(broker, text, rc);
    }

    static inline CMPIArray* CMNewArray(const CMPIBroker* broker, CMPICount size, CMPIType elementType, CMPIStatus* rc)
    {
        return broker->eft->newArray(broker, size, elementType, rc);
    }

    static inline CMPIDateTime* CMNewDateTime(const CMPIBroker* broker, CMPIStatus* rc)
    {
        return broker->eft->newDateTime(broker, rc);
    }

    static inline CMPIDateTime* CMNewDateTimeFromBinary(const CMPIBroker* broker, CMPIUint64 usec, CMPIBoolean interval,
                                                        CMPIStatus* rc)
    {
        return broker->eft->newDateTimeFromBinary(broker, usec, interval, rc);
    }

    static inline CMPIDateTime* CMNewDateTimeFromChars(const CMPIBroker* broker, const char* text, CMPIStatus* rc)
    {
        return broker->eft->newDateTimeFromChars(broker, text, rc);
    }

    static inline CMPISelectExp* CMNewSelectExp(const CMPIBroker* broker, const char* query, const char* language,
                                                CMPIArray** projection, CMPIStatus* rc)
    {
        return broker->eft->newSelectExp(broker, query, language, projection, rc);
    }

    static inline CMPIBoolean CMClassPathIsA(const CMPIBroker* broker, const CMPIObjectPath* path, const char* className,
                                             CMPIStatus* rc)
    {
        return broker->eft->classPathIsA(broker, path, className, rc);
    }

    static inline CMPIString* CDToString(const CMPIBroker* broker, const void* object, CMPIStatus* rc)
    {
        return broker->eft->toString(broker, object, rc);
    }

    static inline CMPIBoolean CDIsOfType(const CMPIBroker* broker, const void* object, const char* type, CMPIStatus* rc)
    {
        return broker->eft->isOfType(broker, object, type, rc);
    }

    static inline CMPIString* CDGetType(const CMPIBroker* broker, const void* object, CMPIStatus* rc)
    {
        return broker->eft->getType(broker, object, rc);
    }

    static inline CMPIStatus CMLogMessage(const CMPIBroker* broker, int severity, const char* id, const char* text,
                                          const CMPIString* string)
    {
        return broker->eft->logMessage(broker, severity, id, text, string);
    }

    static inline CMPIStatus CMTraceMessage(const CMPIBroker* broker, int level, const char* component, const char* text,
                                            const CMPIString* string)
    {
        return broker->eft->trace(broker, level, component, text, string);
    }

    /* ---- instances ---- */

    static inline CMPIData CMGetProperty(const CMPIInstance* instance, const char* name, CMPIStatus* rc)
    {
        return instance->ft->getProperty(instance, name, rc);
    }

    static inline CMPIData CMGetPropertyAt(const CMPIInstance* instance, CMPICount index, CMPIString** name, CMPIStatus* rc)
    {
        return instance->ft->getPropertyAt(instance, index, name, rc);
    }

    static inline CMPICount CMGetPropertyCount(const CMPIInstance* instance, CMPIStatus* rc)
    {
        return instance->ft->getPropertyCount(instance, rc);
    }

    static inline CMPIStatus CMSetProperty(const CMPIInstance* instance, const char* name, const void* value, CMPIType type)
    {
        return instance->ft->setProperty(instance, name, (const CMPIValue*)value, type);
    }

    static inline CMPIObjectPath* CMGetObjectPath(const CMPIInstance* instance, CMPIStatus* rc)
    {
        return instance->ft->getObjectPath(instance, rc);
    }

    static inline CMPIStatus CMSetPropertyFilter(CMPIInstance* instance, const char** properties, const char** keys)
    {
        return instance->ft->setPropertyFilter(instance, properties, keys);
    }

    static inline CMPIStatus CMSetObjectPath(CMPIInstance* instance, const CMPIObjectPath* path)
    {
        return instance->ft->setObjectPath(instance, path);
    }

    /* ---- object paths ---- */

    static inline CMPIStatus CMSetNameSpace(CMPIObjectPath* path, const char* nameSpace)
    {
        return path->ft->setNameSpace(path, nameSpace);
    }

    static inline CMPIString* CMGetNameSpace(const CMPIObjectPath* path, CMPIStatus* rc)
    {
        return path->ft->getNameSpace(path, rc);
    }

    static inline CMPIStatus CMSetHostname(CMPIObjectPath* path, const char* host) { return path->ft->setHostname(path, host); }

    static inline CMPIString* CMGetHostname(const CMPIObjectPath* path, CMPIStatus* rc)
    {
        return path->ft->getHostname(path, rc);
    }

    static inline CMPIStatus CMSetClassName(CMPIObjectPath* path, const char* className)
    {
        return path->ft->setClassName(path, className);
    }

    static inline CMPIString* CMGetClassName(const CMPIObjectPath* path, CMPIStatus* rc)
    {
        return path->ft->getClassName(path, rc);
    }

    static inline CMPIStatus CMAddKey(CMPIObjectPath* path, const char* name, const void* value, CMPIType type)
    {
        return path->ft->addKey(path, name, (const CMPIValue*)value, type);
    }

    static inline CMPIData CMGetKey(const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
    {
        return path->ft->getKey(path, name, rc);
    }

    static inline CMPIData CMGetKeyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* rc)
    {
        return path->ft->getKeyAt(path, index, name, rc);
    }

    static inline CMPICount CMGetKeyCount(const CMPIObjectPath* path, CMPIStatus* rc) { return path->ft->getKeyCount(path, rc); }

    static inline CMPIStatus CMSetNameSpaceFromObjectPath(CMPIObjectPath* path, const CMPIObjectPath* source)
    {
        return path->ft->setNameSpaceFromObjectPath(path, source);
    }

    static inline CMPIStatus CMSetHostAndNameSpaceFromObjectPath(CMPIObjectPath* path, const CMPIObjectPath* source)
    {
        return path->ft->setHostAndNameSpaceFromObjectPath(path, source);
    }

    static inline CMPIData CMGetClassQualifier(const CMPIObjectPath* path, const char* qualifier, CMPIStatus* rc)
    {
        return path->ft->getClassQualifier(path, qualifier, rc);
    }

    static inline CMPIData CMGetPropertyQualifier(const CMPIObjectPath* path, const char* property, const char* qualifier,
                                                  CMPIStatus* rc)
    {
        return path->ft->getPropertyQualifier(path, property, qualifier, rc);
    }

    static inline CMPIData CMGetMethodQualifier(const CMPIObjectPath* path, const char* method, const char* qualifier,
                                                CMPIStatus* rc)
    {
        return path->ft->getMethodQualifier(path, method, qualifier, rc);
    }

    static inline CMPIData CMGetParameterQualifier(const CMPIObjectPath* path, const char* method, const char* parameter,
                                                   const char* qualifier, CMPIStatus* rc)
    {
        return path->ft->getParameterQualifier(path, method, parameter, qualifier, rc);
    }

    /* ---- arguments ---- */

    static inline CMPIStatus CMAddArg(const CMPIArgs* args, const char* name, const void* value, CMPIType type)
    {
        return args->ft->addArg(args, name, (const CMPIValue*)value, type);
    }

    static inline CMPIData CMGetArg(const CMPIArgs* args, const char* name, CMPIStatus* rc)
    {
        return args->ft->getArg(args, name, rc);
    }

    static inline CMPIData CMGetArgAt(const CMPIArgs* args, CMPICount index, CMPIString** name, CMPIStatus* rc)
    {
        return args->ft->getArgAt(args, index, name, rc);
    }

    static inline CMPICount CMGetArgCount(const CMPIArgs* args, CMPIStatus* rc) { return args->ft->getArgCount(args, rc); }

    /* ---- strings, arrays, datetimes, enumerations ---- */

    static inline const char* CMGetCharsPtr(const CMPIString* string, CMPIStatus* rc)
    {
        return string->ft->getCharPtr(string, rc);
    }

    static inline CMPICount CMGetArrayCount(const CMPIArray* array, CMPIStatus* rc) { return array->ft->getSize(array, rc); }

    static inline CMPIType CMGetArrayType(const CMPIArray* array, CMPIStatus* rc) { return array->ft->getSimpleType(array, rc); }

    static inline CMPIData CMGetArrayElementAt(const CMPIArray* array, CMPICount index, CMPIStatus* rc)
    {
        return array->ft->getElementAt(array, index, rc);
    }

    static inline CMPIStatus CMSetArrayElementAt(CMPIArray* array, CMPICount index, const void* value, CMPIType type)
    {
        return array->ft->setElementAt(array, index, (const CMPIValue*)value, type);
    }

    static inline CMPIUint64 CMGetBinaryFormat(const CMPIDateTime* datetime, CMPIStatus* rc)
    {
        return datetime->ft->getBinaryFormat(datetime, rc);
    }

    static inline CMPIString* CMGetStringFormat(const CMPIDateTime* datetime, CMPIStatus* rc)
    {
        return datetime->ft->getStringFormat(datetime, rc);
    }

    static inline CMPIBoolean CMIsInterval(const CMPIDateTime* datetime, CMPIStatus* rc)
    {
        return datetime->ft->isInterval(datetime, rc);
    }

    static inline CMPIData CMGetNext(const CMPIEnumeration* enumeration, CMPIStatus* rc)
    {
        return enumeration->ft->getNext(enumeration, rc);
    }

    static inline CMPIBoolean CMHasNext(const CMPIEnumeration* enumeration, CMPIStatus* rc)
    {
        return enumeration->ft->hasNext(enumeration, rc);
    }

    static inline CMPIArray* CMToArray(const CMPIEnumeration* enumeration, CMPIStatus* rc)
    {
        return enumeration->ft->toArray(enumeration, rc);
    }

    /* ---- results and contexts ---- */

    static inline CMPIStatus CMReturnData(const CMPIResult* result, const void* value, CMPIType type)
    {
        return result->ft->returnData(result, (const CMPIValue*)value, type);
    }

    static inline CMPIStatus CMReturnInstance(const CMPIResult* result, const CMPIInstance* instance)
    {
        return result->ft->returnInstance(result, instance);
    }

    static inline CMPIStatus CMReturnObjectPath(const CMPIResult* result, const CMPIObjectPath* path)
    {
        return result->ft->returnObjectPath(result, path);
    }

    static inline CMPIStatus CMReturnDone(const CMPIResult* result) { return result->ft->returnDone(result); }

    static inline CMPIData CMGetContextEntry(const CMPIContext* context, const char* name, CMPIStatus* rc)
    {
        return context->ft->getEntry(context, name, rc);
    }

    static inline CMPIData CMGetContextEntryAt(const CMPIContext* context, CMPICount index, CMPIString** name, CMPIStatus* rc)
    {
        return context->ft->getEntryAt(context, index, name, rc);
    }

    static inline CMPICount CMGetContextEntryCount(const CMPIContext* context, CMPIStatus* rc)
    {
        return context->ft->getEntryCount(context, rc);
    }

    static inline CMPIStatus CMAddContextEntry(const CMPIContext* context, const char* name, const void* value, CMPIType type)
    {
        return context->ft->addEntry(context, name, (const CMPIValue*)value, type);
    }

    /* ---- select expressions ---- */

    static inline CMPIBoolean CMEvaluateSelExp(const CMPISelectExp* expression, const CMPIInstance* instance, CMPIStatus* rc)
    {
        return expression->ft->evaluate(expression, instance, rc);
    }

    static inline CMPIBoolean CMEvaluateSelExpUsingAccessor(const CMPISelectExp* expression, CMPIAccessor* accessor,
                                                            void* parameter, CMPIStatus* rc)
    {
        return expression->ft->evaluateUsingAccessor(expression, accessor, parameter, rc);
    }

    static inline CMPIString* CMGetSelExpString(const CMPISelectExp* expression, CMPIStatus* rc)
    {
        return expression->ft->getString(expression, rc);
    }

    static inline CMPISelectCond* CMGetDoc(const CMPISelectExp* expression, CMPIStatus* rc)
    {
        return expression->ft->getDOC(expression, rc);
    }

    static inline CMPISelectCond* CMGetCod(const CMPISelectExp* expression, CMPIStatus* rc)
    {
        return expression->ft->getCOD(expression, rc);
    }

    /* ---- services of the broker ---- */

    static inline CMPIContext* CBPrepareAttachThread(const CMPIBroker* broker, const CMPIContext* context)
    {
        return broker->bft->prepareAttachThread(broker, context);
    }

    static inline CMPIStatus CBAttachThread(const CMPIBroker* broker, const CMPIContext* context)
    {
        return broker->bft->attachThread(broker, context);
    }

    static inline CMPIStatus CBDetachThread(const CMPIBroker* broker, const CMPIContext* context)
    {
        return broker->bft->detachThread(broker, context);
    }

    static inline CMPIStatus CBDeliverIndication(const CMPIBroker* broker, const CMPIContext* context, const char* nameSpace,
                                                 const CMPIInstance* indication)
    {
        return broker->bft->deliverIndication(broker, context, nameSpace, indication);
    }

    static inline CMPIEnumeration* CBEnumInstanceNames(const CMPIBroker* broker, const CMPIContext* context,
                                                       const CMPIObjectPath* path, CMPIStatus* rc)
    {
        return broker->bft->enumerateInstanceNames(broker, context, path, rc);
    }

    static inline CMPIEnumeration* CBEnumInstances(const CMPIBroker* broker, const CMPIContext* context,
                                                   const CMPIObjectPath* path, const char** properties, CMPIStatus* rc)
    {
        return broker->bft->enumerateInstances(broker, context, path, properties, rc);
    }

    static inline CMPIInstance* CBGetInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                              const char** properties, CMPIStatus* rc)
    {
        return broker->bft->getInstance(broker, context, path, properties, rc);
    }

    static inline CMPIObjectPath* CBCreateInstance(const CMPIBroker* broker, const CMPIContext* context,
                                                   const CMPIObjectPath* path, const CMPIInstance* instance, CMPIStatus* rc)
    {
        return broker->bft->createInstance(broker, context, path, instance, rc);
    }

    static inline CMPIStatus CBModifyInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                              const CMPIInstance* instance, const char** properties)
    {
        return broker->bft->modifyInstance(broker, context, path, instance, properties);
    }

    static inline CMPIStatus CBDeleteInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path)
    {
        return broker->bft->deleteInstance(broker, context, path);
    }

    static inline CMPIEnumeration* CBExecQuery(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                               const char* query, const char* language, CMPIStatus* rc)
    {
        return broker->bft->execQuery(broker, context, path, query, language, rc);
    }

    static inline CMPIEnumeration* CBAssociators(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                                 const char* assocClass, const char* resultClass, const char* role,
                                                 const char* resultRole, const char** properties, CMPIStatus* rc)
    {
        return broker->bft->associators(broker, context, path, assocClass, resultClass, role, resultRole, properties, rc);
    }

    static inline CMPIEnumeration* CBAssociatorNames(const CMPIBroker* broker, const CMPIContext* context,
                                                     const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                                                     const char* role, const char* resultRole, CMPIStatus* rc)
    {
        return broker->bft->associatorNames(broker, context, path, assocClass, resultClass, role, resultRole, rc);
    }

    static inline CMPIEnumeration* CBReferences(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                                const char* resultClass, const char* role, const char** properties,
                                                CMPIStatus* rc)
    {
        return broker->bft->references(broker, context, path, resultClass, role, properties, rc);
    }

    static inline CMPIEnumeration* CBReferenceNames(const CMPIBroker* broker, const CMPIContext* context,
                                                    const CMPIObjectPath* path, const char* resultClass, const char* role,
                                                    CMPIStatus* rc)
    {
        return broker->bft->referenceNames(broker, context, path, resultClass, role, rc);
    }

    static inline CMPIData CBInvokeMethod(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                          const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus* rc)
    {
        return broker->bft->invokeMethod(broker, context, path, method, in, out, rc);
    }

    static inline CMPIStatus CBSetProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                           const char* name, const void* value, CMPIType type)
    {
        return broker->bft->setProperty(broker, context, path, name, (const CMPIValue*)value, type);
    }

    static inline CMPIData CBGetProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                                         const char* name, CMPIStatus* rc)
    {
        return broker->bft->getProperty(broker, context, path, name, rc);
    }

#ifdef __cplusplus
}
#endif
