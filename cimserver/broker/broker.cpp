#include "cimserver/broker/broker.h"

#include "cimserver/broker/object.h"

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

} // namespace cimserver
