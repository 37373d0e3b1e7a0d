// The broker's extension table: threads and what they need. The module has its own.
#include "cimserver/broker/broker.h"
#include "cimserver/broker/not_offered.h"

namespace cimserver
{

const CMPIBrokerExtFT system_service_table = {
    .ftVersion = 100,
    .resolveFileName = not_offered,
    .newThread = not_offered,
    .joinThread = not_offered,
    .exitThread = not_offered,
    .cancelThread = not_offered,
    .threadSleep = not_offered,
    .threadOnce = not_offered,
    .createThreadKey = not_offered,
    .destroyThreadKey = not_offered,
    .getThreadSpecific = not_offered,
    .setThreadSpecific = not_offered,
    .newMutex = not_offered,
    .destroyMutex = not_offered,
    .lockMutex = not_offered,
    .unlockMutex = not_offered,
    .newCondition = not_offered,
    .destroyCondition = not_offered,
    .condWait = not_offered,
    .timedCondWait = not_offered,
    .signalCondition = not_offered,
};

} // namespace cimserver
