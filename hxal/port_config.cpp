#include "hxal/config/setters.h"
#include "hxal/internal/request.h"
#include "hxal/port.h"

namespace
{

// Sends the record, and records the setting once the driver has taken it.
template <typename Record, typename Setter>
hxa_status_t configure(const hxal_s& ioc, hxal::Command_Name<std::type_identity_t<Record>> command, Record& record,
                       Setter record_setting)
{
    const hxa_status_t status = hxal::exchange(ioc, command, record);
    if (status == HXA_STATUS_OK)
        record_setting();
    return status;
}

} // namespace

hxa_status_t hxal_port_cfg_topology(const hxal_t* ioc, hxa_pport_topology_t topo)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_cfg_topo_t>(*ioc);
    record.topo = topo;
    return configure(*ioc, "IOCMD_PORT_CFG_TOPO", record, [=] { hxal_config_topology(ioc, topo); });
}

hxa_status_t hxal_port_cfg_speed(const hxal_t* ioc, hxa_pport_speed_t speed)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_cfg_speed_t>(*ioc);
    record.speed = speed;
    return configure(*ioc, "IOCMD_PORT_CFG_SPEED", record, [=] { hxal_config_speed(ioc, speed); });
}

hxa_status_t hxal_port_cfg_maxfrsize(const hxal_t* ioc, uint16_t maxfrsize)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_cfg_maxfrsize_t>(*ioc);
    record.maxfrsize = maxfrsize;
    return configure(*ioc, "IOCMD_PORT_CFG_MAXFRSZ", record, [=] { hxal_config_maxfrsz(ioc, maxfrsize); });
}

hxa_status_t hxal_port_cfg_hardalpa(const hxal_t* ioc, uint8_t alpa)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_alpa_t>(*ioc);
    record.alpa = alpa;
    return configure(*ioc, "IOCMD_PORT_CFG_ALPA", record, [=] { hxal_config_alpa(ioc, alpa, HXA_TRUE); });
}

hxa_status_t hxal_port_clr_hardalpa(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_alpa_t>(*ioc);
    return configure(*ioc, "IOCMD_PORT_CLR_ALPA", record, [=] { hxal_config_alpa(ioc, 0, HXA_FALSE); });
}

hxa_status_t hxal_port_trunk_enable(const hxal_t* ioc, uint32_t pp_bmap)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_trunk_t>(*ioc);
    record.pp_bmap = static_cast<uint8_t>(pp_bmap);
    return configure(*ioc, "IOCMD_PORT_TRUNK_ENABLE", record, [=] { hxal_config_trunk(ioc, pp_bmap, HXA_TRUE); });
}

hxa_status_t hxal_port_trunk_disable(const hxal_t* ioc)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_trunk_t>(*ioc);
    return configure(*ioc, "IOCMD_PORT_TRUNK_DISABLE", record, [=] { hxal_config_trunk(ioc, 0, HXA_FALSE); });
}

hxa_status_t hxal_port_cfg_rnid_info(const hxal_t* ioc, hxa_pport_rnid_t info)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_port_rnid_t>(*ioc);
    record.info = info;
    return hxal::exchange(*ioc, "IOCMD_PORT_CFG_RNID", record);
}

hxa_status_t hxal_port_get_rnid_info(const hxal_t* ioc, hxa_pport_rnid_t* info)
{
    return hxal::read(ioc, "IOCMD_PORT_GET_RNID", &hxa_ioctl_port_rnid_t::info, info);
}
