#include "hxal/sfp.h"

#include "hxal/internal/request.h"

hxa_status_t hxal_sfp_media(const hxal_t* ioc, hxa_defs_sfp_media_t* media)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_sfp_media_t>(*ioc);
    return hxal::exchange(*ioc, "IOCMD_SFP_MEDIA", record, &hxa_ioctl_sfp_media_t::media, media);
}

hxa_status_t hxal_sfp_speed(const hxal_t* ioc, uint32_t speed)
{
    if (!ioc)
        return HXA_STATUS_EINVAL;
    auto record = hxal::request_for<hxa_ioctl_sfp_speed_t>(*ioc);
    record.speed = speed;
    return hxal::exchange(*ioc, "IOCMD_SFP_SPEED", record);
}
