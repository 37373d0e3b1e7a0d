#include "hxal/library.h"

#include "hxal/config/parser.h"
#include "hxal/config/writer.h"
#include "hxal/internal/adapter_list.h"
#include "hxal/internal/application.h"
#include "hxal/internal/ioc_list.h"

#include <atomic>
#include <cerrno>

namespace
{

constexpr char config_path[] = "/etc/hxa.conf";

// Atomic because the event thread and any caller may meet in them; neither guards anything else.
constinit std::atomic<hxa_aen_app_t> application_id{hxa_aen_app_tessik};
constinit std::atomic<hxa_status_t> last_status{HXA_STATUS_OK};

struct Error_Status
{
    int error;
    hxa_status_t status;
};

// clang-format off
constexpr Error_Status error_statuses[] = {
    {EINTR,  HXA_STATUS_EINTR},
    {EIO,    HXA_STATUS_EIO},
    {ENXIO,  HXA_STATUS_ENXIO},
    {EBADF,  HXA_STATUS_EBADF},
    {ENODEV, HXA_STATUS_NODEV},
    {EINVAL, HXA_STATUS_EINVAL},
    {ENOTTY, HXA_STATUS_ENOTTY},
};
// clang-format on

} // namespace

hxa_aen_app_t hxal::current_application() { return application_id; }

int hxal_libinit(hxa_aen_app_t app)
{
    application_id = app;
    return 0;
}

void hxal_libexit(void) {}

void hxal_libkeep(void)
{
    hxal::keep_iocs();
    hxal::keep_adapters();
}

hxa_status_t hxal_libload(void) { return hxal_config_load(config_path); }
void hxal_libsync(void) { hxal_config_sync(config_path); }
void hxal_libunload(void) { hxal_config_unload(); }

void hxal_set_last_error(hxa_status_t status) { last_status = status; }
hxa_status_t hxal_get_last_error(void) { return last_status; }

hxa_status_t hxal_get_status(int error)
{
    for (const Error_Status& row : error_statuses)
        if (row.error == error)
            return row.status;
    return HXA_STATUS_FAILED;
}

uint32_t hxal_checksum_u8(const uint8_t* bytes, uint32_t count)
{
    uint32_t sum = 0;
    for (uint32_t i = 0; i < count; ++i)
        sum += bytes[i];
    return (0 - sum) & 0xFF;
}

uint32_t hxa_checksum_u32(const uint32_t* words, int size)
{
    uint32_t sum = 0;
    for (int i = 0; i < size >> 2; ++i)
        sum ^= words[i];
    return sum;
}
