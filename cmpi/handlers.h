// The handlers through which a provider hands over what it produces.
//
// Every object handed over is a new instance (typically a clone) whose one reference passes to the receiver. handle()
// answers whether the provider shall go on. A provider never hands over null.
#pragma once

#include "cmpi/status.h"
#include "runtime/instance.h"

namespace zmlr
{

// Receives one enumerated object, the status and the client data; false stops the enumeration. The last call is the one for a
// null object: the provider procedure makes it with the provider's status when the provider is done, also when it failed or was
// told to stop. Of a provider that answers *_UNSUPPORTED the caller makes it, after its own enumeration. An Indication_Proc is
// told null by a provider that will raise no more, if it says so at all.
using Enum_Instances_Proc = bool (*)(Instance* instance, Enum_Instances_Status status, void* client_data);
using Enum_Associators_Proc = bool (*)(Instance* instance, Enum_Associators_Status status, void* client_data);
using Enum_Associator_Names_Proc = bool (*)(Instance* instance, Enum_Associator_Names_Status status, void* client_data);
using Enum_References_Proc = bool (*)(Instance* instance, Enum_References_Status status, void* client_data);
using Indication_Proc = bool (*)(Instance* indication, void* client_data);

template <class T, class Proc, auto OK> class Handler
{
public:
    Handler(Proc proc, void* client_data) : _proc(proc), _client_data(client_data) {}
    bool handle(T* instance) { return _proc(instance, OK, _client_data); }

private:
    Proc _proc;
    void* _client_data;
};

template <class T> using Enum_Instances_Handler = Handler<T, Enum_Instances_Proc, ENUM_INSTANCES_OK>;
template <class T> using Enum_Associators_Handler = Handler<T, Enum_Associators_Proc, ENUM_ASSOCIATORS_OK>;
template <class T> using Enum_Associator_Names_Handler = Handler<T, Enum_Associator_Names_Proc, ENUM_ASSOCIATOR_NAMES_OK>;
template <class T> using Enum_References_Handler = Handler<T, Enum_References_Proc, ENUM_REFERENCES_OK>;

template <class T> class Indication_Handler
{
public:
    Indication_Handler(Indication_Proc proc, void* client_data) : _proc(proc), _client_data(client_data) {}
    bool handle(T* indication) { return _proc(indication, _client_data); }

private:
    Indication_Proc _proc;
    void* _client_data;
};

} // namespace zmlr
