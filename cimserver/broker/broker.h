// Broker: what the server lends to the module: the CMPI broker with its three function tables.
//
// Objects can be made and examined, threads attached, indications delivered, and the server's operations called (up-calls),
// on any thread and from within a request. What this server does not offer answers CMPI_RC_ERR_NOT_SUPPORTED.
#pragma once

#include "cimserver/model/repository.h"
#include "cimserver/model/values.h"

#include <cmpift.h>

#include <atomic>

namespace cimserver
{

class Name_Spaces;

// Takes the indications that providers raise.
class Indication_Sink
{
public:
    Indication_Sink() = default;
    virtual ~Indication_Sink() = default;
    Indication_Sink(const Indication_Sink&) = delete;
    Indication_Sink& operator=(const Indication_Sink&) = delete;

    // Called on a thread of the module, which holds its provider's lock meanwhile: must neither wait for a listener nor call
    // the provider. What it throws becomes the module's return code (Failure's own; CMPI_RC_ERR_FAILED for any other).
    virtual void deliver(const std::string& name_space, const Instance& indication) = 0;
};

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
    void set_name_spaces(Name_Spaces* name_spaces) { _name_spaces = name_spaces; }
    Name_Spaces& name_spaces() const; // throws Failure NOT_SUPPORTED when nobody is named

    // Who takes indications; null (as at first): nobody. Whoever is named must stay until the module is closed.
    void set_indication_sink(Indication_Sink* sink) { _indication_sink = sink; }
    Indication_Sink& indication_sink() const; // throws Failure NOT_SUPPORTED when nobody is named

private:
    CMPIBroker _face;
    const Repository& _repository;
    std::atomic<Name_Spaces*> _name_spaces = nullptr;
    std::atomic<Indication_Sink*> _indication_sink = nullptr;
};

// The broker behind its handle. Throws INVALID_HANDLE.
const Broker& broker_of(const CMPIBroker* face);

extern const CMPIBrokerFT broker_table;           // up_calls.cpp
extern const CMPIBrokerEncFT encapsulation_table; // encapsulation.cpp
extern const CMPIBrokerExtFT system_service_table;

} // namespace cimserver
