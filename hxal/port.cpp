#include "hxal/port.h"

#include "hxal/internal/request.h"
#include "hxal/value_names.h"

hxa_status_t hxal_port_get_attr(const hxal_t* ioc, hxa_pport_attr_t* attr)
{
    return hxal::read(ioc, "IOCMD_PORT_GET_ATTR", &hxa_ioctl_port_attr_t::attr, attr);
}

const char* hxal_port_get_state_name(uint32_t state)
{
    return state < HXA_PPORT_ST_MAX_STATE ? hxal_pport_states_to_string(state) : "Unknown";
}

hxa_status_t hxal_port_reset_stats(const hxal_t* ioc) { return hxal::request(ioc, "IOCMD_PORT_RESET_STATS"); }
