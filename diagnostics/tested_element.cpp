#include "diagnostics/tested_element.h"

#include "inventory/adapter_helper.h"
#include "inventory/ethernet_port_helper.h"
#include "inventory/port_helper.h"
#include "schema/CIM_LogicalDevice.h"

namespace zmlr
{

namespace
{

template <class Helper>
const Instance_Array& read_once(std::optional<Instance_Array>& instances, const Helper& helper, classId_t class_id,
                                const Inventory_Request& request)
{
    if (!instances)
        instances.emplace(helper.getInstancesByClass(class_id, request));
    return *instances;
}

} // namespace

// The request's keys are those of a record or of a job, not of an element.
Tested_Elements::Tested_Elements(const Inventory_Request& request) : _request{.host = request.host, .wanted = {}} {}

const Instance_Array& Tested_Elements::all_of(classId_t class_id)
{
    switch (class_id)
    {
    case CLASSID_PortController:
        return read_once(_adapters, AdapterHelper::getAdapterHelperInstance(), class_id, _request);
    case CLASSID_FCPort:
        return read_once(_fc_ports, PortHelper::getPortHelperObject(), class_id, _request);
    default:
        return read_once(_ethernet_ports, EthernetPortHelper::getEthernetPortHelperObject(), class_id, _request);
    }
}

Ref<Instance> Tested_Elements::find(const Tested_Element& element)
{
    for (Instance* instance : all_of(element.class_id))
    {
        const auto* device = cast<CIM_LogicalDevice>(instance);
        if (device && element.address.equali(device->DeviceID.value))
            return share(instance);
    }
    return Ref<Instance>();
}

String Tested_Elements::name_of(const Tested_Element& element)
{
    const Ref<Instance> instance = find(element);
    const auto* device = cast<CIM_LogicalDevice>(instance.ptr());
    return device ? device->ElementName.value : String();
}

} // namespace zmlr
