#include "cimserver/broker/broker.h"

#include "cimserver/broker/object.h"

namespace cimserver
{

Broker::Broker(const Repository& repository)
    : _face{this, &broker_table, &encapsulation_table, &system_service_table}
    , _repository(repository)
{
}

Operations& Broker::operations() const
{
    Operations* operations = _operations;
    if (!operations)
        throw Failure{CMPI_RC_ERR_NOT_SUPPORTED};
    return *operations;
}

const Broker& broker_of(const CMPIBroker* face)
{
    if (!face || !face->hdl)
        throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    return *static_cast<const Broker*>(face->hdl);
}

} // namespace cimserver
