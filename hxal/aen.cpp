#include "hxal/aen.h"

#include "hxal/internal/request.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>

namespace
{

struct Snia_Code
{
    uint32_t category;
    uint32_t event;
    uint32_t code;
};

// clang-format off
constexpr Snia_Code snia_codes[] = {
    {HXA_AEN_CAT_ADAPTER, HXA_ADAPTER_AEN_ADD,      0x101},
    {HXA_AEN_CAT_ADAPTER, HXA_ADAPTER_AEN_REMOVE,   0x102},
    {HXA_AEN_CAT_LPORT,   HXA_LPORT_AEN_ONLINE,     0x202},
    {HXA_AEN_CAT_LPORT,   HXA_LPORT_AEN_OFFLINE,    0x201},
    {HXA_AEN_CAT_ITNIM,   HXA_ITNIM_AEN_ONLINE,     0x402},
    {HXA_AEN_CAT_ITNIM,   HXA_ITNIM_AEN_OFFLINE,    0x401},
    {HXA_AEN_CAT_ITNIM,   HXA_ITNIM_AEN_DISCONNECT, 0x403},
};
// clang-format on

} // namespace

hxa_status_t hxal_aen_get_events(const hxal_t* ioc, hxa_aen_entry_t* out, int* count, hxa_aen_app_t app)
{
    if (!ioc || !out || !count)
        return HXA_STATUS_EINVAL;
    hxal_ioctl_aen_t record{};
    record.hxad_num = ioc->instance;
    record.aen_count = std::clamp(*count, 0, HXA_AEN_MAX_ENTRIES);
    record.app_id = app;
    const int room = record.aen_count;
    if (const hxa_status_t sent = hxal::send(*ioc, "IOCMD_AEN_GET", record); sent != HXA_STATUS_OK)
    {
        std::printf("%s:%d ioctl error: %s, fd: %d, app: %d inst: %d\n", __func__, __LINE__, std::strerror(errno), ioc->fd, app,
                    ioc->instance);
        return sent;
    }
    std::copy_n(record.aen_list, room, out);
    *count = record.aen_count;
    return record.status;
}

uint32_t hxal_snia_event_convert(uint32_t category, uint32_t event)
{
    const auto* row = std::find_if(std::begin(snia_codes), std::end(snia_codes),
                                   [=](const Snia_Code& each) { return each.category == category && each.event == event; });
    return row == std::end(snia_codes) ? 0 : row->code;
}
