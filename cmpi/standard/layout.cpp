// The binary contract of the CMPI 1.00 tables on LP64 Linux, member by member: a table that drifts stops the build.
#include <cmpift.h>

#include <cstddef>
#include <initializer_list>

namespace
{

// Whether the members at these offsets are all pointers of the table behind its head, in this order.
template <class Table> constexpr bool in_order(std::size_t first, std::initializer_list<std::size_t> offsets)
{
    std::size_t expected = first;
    for (const std::size_t offset : offsets)
    {
        if (offset != expected)
            return false;
        expected += sizeof(void*);
    }
    return expected == sizeof(Table);
}

template <class Object> constexpr bool is_handle()
{
    return offsetof(Object, hdl) == 0 && offsetof(Object, ft) == 8 && sizeof(Object) == 16;
}

static_assert(offsetof(CMPIData, type) == 0 && offsetof(CMPIData, state) == 2 && offsetof(CMPIData, value) == 8);
static_assert(offsetof(CMPIStatus, rc) == 0 && offsetof(CMPIStatus, msg) == 8 && sizeof(CMPIrc) == 4);
static_assert(offsetof(CMPIValuePtr, ptr) == 0 && offsetof(CMPIValuePtr, length) == 8);

static_assert(is_handle<CMPIContext>() && is_handle<CMPIResult>() && is_handle<CMPIInstance>() && is_handle<CMPIObjectPath>());
static_assert(is_handle<CMPIArgs>() && is_handle<CMPIString>() && is_handle<CMPIArray>() && is_handle<CMPIEnumeration>());
static_assert(is_handle<CMPIDateTime>() && is_handle<CMPISelectExp>() && is_handle<CMPISelectCond>());
static_assert(is_handle<CMPISubCond>() && is_handle<CMPIPredicate>() && is_handle<CMPIInstanceMI>());
static_assert(is_handle<CMPIAssociationMI>() && is_handle<CMPIMethodMI>() && is_handle<CMPIIndicationMI>());

namespace broker
{
using T = CMPIBroker;
static_assert(in_order<T>(0, {offsetof(T, hdl), offsetof(T, bft), offsetof(T, eft), offsetof(T, xft)}));
} // namespace broker

namespace broker_ft
{
using T = CMPIBrokerFT;
static_assert(offsetof(T, brokerCapabilities) == 0 && offsetof(T, brokerVersion) == 4 && offsetof(T, brokerName) == 8);
static_assert(in_order<T>(16, {offsetof(T, prepareAttachThread), offsetof(T, attachThread), offsetof(T, detachThread),
                               offsetof(T, deliverIndication), offsetof(T, enumerateInstanceNames), offsetof(T, getInstance),
                               offsetof(T, createInstance), offsetof(T, modifyInstance), offsetof(T, deleteInstance),
                               offsetof(T, execQuery), offsetof(T, enumerateInstances), offsetof(T, associators),
                               offsetof(T, associatorNames), offsetof(T, references), offsetof(T, referenceNames),
                               offsetof(T, invokeMethod), offsetof(T, setProperty), offsetof(T, getProperty)}));
} // namespace broker_ft

namespace broker_enc_ft
{
using T = CMPIBrokerEncFT;
static_assert(in_order<T>(8, {offsetof(T, newInstance), offsetof(T, newObjectPath), offsetof(T, newArgs), offsetof(T, newString),
                              offsetof(T, newArray), offsetof(T, newDateTime), offsetof(T, newDateTimeFromBinary),
                              offsetof(T, newDateTimeFromChars), offsetof(T, newSelectExp), offsetof(T, classPathIsA),
                              offsetof(T, toString), offsetof(T, isOfType), offsetof(T, getType), offsetof(T, getMessage),
                              offsetof(T, logMessage), offsetof(T, trace)}));
} // namespace broker_enc_ft

namespace broker_ext_ft
{
using T = CMPIBrokerExtFT;
static_assert(in_order<T>(8, {offsetof(T, resolveFileName),   offsetof(T, newThread),         offsetof(T, joinThread),
                              offsetof(T, exitThread),        offsetof(T, cancelThread),      offsetof(T, threadSleep),
                              offsetof(T, threadOnce),        offsetof(T, createThreadKey),   offsetof(T, destroyThreadKey),
                              offsetof(T, getThreadSpecific), offsetof(T, setThreadSpecific), offsetof(T, newMutex),
                              offsetof(T, destroyMutex),      offsetof(T, lockMutex),         offsetof(T, unlockMutex),
                              offsetof(T, newCondition),      offsetof(T, destroyCondition),  offsetof(T, condWait),
                              offsetof(T, timedCondWait),     offsetof(T, signalCondition)}));
} // namespace broker_ext_ft

namespace context_ft
{
using T = CMPIContextFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, getEntry), offsetof(T, getEntryAt),
                              offsetof(T, getEntryCount), offsetof(T, addEntry)}));
} // namespace context_ft

namespace result_ft
{
using T = CMPIResultFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, returnData), offsetof(T, returnInstance),
                              offsetof(T, returnObjectPath), offsetof(T, returnDone)}));
} // namespace result_ft

namespace instance_ft
{
using T = CMPIInstanceFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, getProperty), offsetof(T, getPropertyAt),
                              offsetof(T, getPropertyCount), offsetof(T, setProperty), offsetof(T, getObjectPath),
                              offsetof(T, setPropertyFilter), offsetof(T, setObjectPath)}));
} // namespace instance_ft

namespace object_path_ft
{
using T = CMPIObjectPathFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, setNameSpace), offsetof(T, getNameSpace),
                              offsetof(T, setHostname), offsetof(T, getHostname), offsetof(T, setClassName),
                              offsetof(T, getClassName), offsetof(T, addKey), offsetof(T, getKey), offsetof(T, getKeyAt),
                              offsetof(T, getKeyCount), offsetof(T, setNameSpaceFromObjectPath),
                              offsetof(T, setHostAndNameSpaceFromObjectPath), offsetof(T, getClassQualifier),
                              offsetof(T, getPropertyQualifier), offsetof(T, getMethodQualifier),
                              offsetof(T, getParameterQualifier), offsetof(T, toString)}));
} // namespace object_path_ft

namespace args_ft
{
using T = CMPIArgsFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, addArg), offsetof(T, getArg),
                              offsetof(T, getArgAt), offsetof(T, getArgCount)}));
} // namespace args_ft

namespace string_ft
{
using T = CMPIStringFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, getCharPtr)}));
} // namespace string_ft

namespace array_ft
{
using T = CMPIArrayFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, getSize), offsetof(T, getSimpleType),
                              offsetof(T, getElementAt), offsetof(T, setElementAt)}));
} // namespace array_ft

namespace enumeration_ft
{
using T = CMPIEnumerationFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, getNext), offsetof(T, hasNext),
                              offsetof(T, toArray)}));
} // namespace enumeration_ft

namespace datetime_ft
{
using T = CMPIDateTimeFT;
static_assert(in_order<T>(8, {offsetof(T, release), offsetof(T, clone), offsetof(T, getBinaryFormat),
                              offsetof(T, getStringFormat), offsetof(T, isInterval)}));
} // namespace datetime_ft

namespace select_ft
{
using S = CMPISelectExpFT;
using C = CMPISelectCondFT;
using U = CMPISubCondFT;
using P = CMPIPredicateFT;
static_assert(in_order<S>(8, {offsetof(S, release), offsetof(S, clone), offsetof(S, evaluate), offsetof(S, getString),
                              offsetof(S, getDOC), offsetof(S, getCOD), offsetof(S, evaluateUsingAccessor)}));
static_assert(in_order<C>(8,
                          {offsetof(C, release), offsetof(C, clone), offsetof(C, getCountAndType), offsetof(C, getSubCondAt)}));
static_assert(in_order<U>(8, {offsetof(U, release), offsetof(U, clone), offsetof(U, getCount), offsetof(U, getPredicateAt),
                              offsetof(U, getPredicate)}));
static_assert(in_order<P>(8,
                          {offsetof(P, release), offsetof(P, clone), offsetof(P, getData), offsetof(P, evaluateUsingAccessor)}));
} // namespace select_ft

// The tables of the management interfaces share a head of two versions and a name.
template <class T> constexpr bool has_mi_head()
{
    return offsetof(T, ftVersion) == 0 && offsetof(T, miVersion) == 4 && offsetof(T, miName) == 8;
}
static_assert(has_mi_head<CMPIInstanceMIFT>() && has_mi_head<CMPIAssociationMIFT>());
static_assert(has_mi_head<CMPIMethodMIFT>() && has_mi_head<CMPIIndicationMIFT>());

namespace mi_ft
{
using I = CMPIInstanceMIFT;
using A = CMPIAssociationMIFT;
using M = CMPIMethodMIFT;
using N = CMPIIndicationMIFT;
static_assert(in_order<I>(16, {offsetof(I, cleanup), offsetof(I, enumerateInstanceNames), offsetof(I, enumerateInstances),
                               offsetof(I, getInstance), offsetof(I, createInstance), offsetof(I, modifyInstance),
                               offsetof(I, deleteInstance), offsetof(I, execQuery)}));
static_assert(in_order<A>(16, {offsetof(A, cleanup), offsetof(A, associators), offsetof(A, associatorNames),
                               offsetof(A, references), offsetof(A, referenceNames)}));
static_assert(in_order<M>(16, {offsetof(M, cleanup), offsetof(M, invokeMethod)}));
static_assert(in_order<N>(16,
                          {offsetof(N, cleanup), offsetof(N, authorizeFilter), offsetof(N, mustPoll), offsetof(N, activateFilter),
                           offsetof(N, deActivateFilter), offsetof(N, enableIndications), offsetof(N, disableIndications)}));
} // namespace mi_ft

} // namespace
