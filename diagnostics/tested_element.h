// What a test runs on.
#pragma once

#include "inventory/class_id.h"
#include "inventory/inventory_request.h"
#include "runtime/instance.h"
#include "runtime/string.h"

#include <optional>

namespace zmlr
{

// An adapter, an FC port or an Ethernet port, by the address that the client gave: its DeviceID.
struct Tested_Element
{
    classId_t class_id = CLASSID_None; // CLASSID_PortController, CLASSID_FCPort or CLASSID_EthernetPort
    String address;
};

// The instances of tested elements, for one request: each class is read from the adapters when an element of it is first asked
// for, and never again.
class Tested_Elements
{
public:
    explicit Tested_Elements(const Inventory_Request& request);

    // The first instance of the class with this address, in any case of letters; null when there is none (any more).
    Ref<Instance> find(const Tested_Element& element);

    // Its ElementName; empty when there is no such instance.
    String name_of(const Tested_Element& element);

private:
    const Instance_Array& all_of(classId_t class_id);

    Inventory_Request _request; // for all instances
    std::optional<Instance_Array> _adapters, _fc_ports, _ethernet_ports;
};

} // namespace zmlr
