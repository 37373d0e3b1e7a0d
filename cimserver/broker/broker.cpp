#include "cimserver/broker/broker.h"

#include "cimserver/broker/not_offered.h"

namespace cimserver
{

Broker::Broker(const Repository& repository)
    : _face{this, &broker_table, &encapsulation_table, &system_service_table}
    , _repository(repository)
{
}

namespace
{

template <class T> T& named(T* whoever)
{
    if (!whoever)
        throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
    return *whoever;
}

} // namespace

Name_Spaces& Broker::name_spaces() const { return named(_name_spaces.load()); }

Indication_Sink& Broker::indication_sink() const { return named(_indication_sink.load()); }

const Broker& broker_of(const CMPIBroker* face)
{
    if (!face || !face->hdl)
        throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    return *static_cast<const Broker*>(face->hdl);
}

// Threads and what they need: the module has its own.
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
