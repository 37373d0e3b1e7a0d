#include "inventory/port_reading.h"

#include "inventory/property_text.h"
#include "runtime/log.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

} // namespace

std::optional<Port_Reading> read_port(const Open_Adapter& adapter, const Open_Port& port, const Inventory_Request& request)
{
    Port_Reading reading = {.adapter = adapter, .port = port, .request = request};
    if (hxal_port_get_attr(port.fc.get(), &reading.attributes) != HXA_STATUS_OK)
    {
        ZMLR_LOG(LL_INFO, "hxal_port_get_attr failed. Adapter=%d, Port=%d ", adapter.index, port.index);
        return std::nullopt;
    }
    fill_port(reading.info, reading.attributes, port.index);
    copy_text(reading.info.host, request.host.text());
    return reading;
}

} // namespace zmlr
