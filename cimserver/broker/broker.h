// Broker: what the server lends to the module: the CMPI broker with its three function tables.
//
// Objects can be made and examined, threads attached, and instances read back through the server (up-calls), on any thread
// and from within a request. Everything else a provider may call answers CMPI_RC_ERR_NOT_SUPPORTED.
#pragma once

#include "cimserver/broker/repository.h"

#include <cmpift.h>

#include <atomic>

namespace cimserver
{

class Operations;

class Broker
{
public:
    // The repository must outlive the broker, and the broker every interface that was made with it.
    explicit Broker(const Repository& repository);
    Broker(const Broker&) = delete;
    Broker& operator=(const Broker&) = delete;

    const CMPIBroker* face() const { return &_face; }
    const Repository& repository() const { return _repository; }

    // Who answers up-calls; null (as at first): nobody. Whoever is named must stay until the module is closed.
    void set_operations(Operations* operations) { _operations = operations; }
    Operations& operations() const; // throws Failure NOT_SUPPORTED when nobody is named

private:
    CMPIBroker _face;
    const Repository& _repository;
    std::atomic<Operations*> _operations = nullptr;
};

// The broker behind its handle. Throws INVALID_HANDLE.
const Broker& broker_of(const CMPIBroker* face);

extern const CMPIBrokerFT broker_table;            // up_calls.cpp
extern const CMPIBrokerEncFT encapsulation_table;  // encapsulation.cpp
extern const CMPIBrokerExtFT system_service_table; // system_services.cpp

} // namespace cimserver
