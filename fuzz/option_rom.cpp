// Any bytes given as an option ROM: fitted or refused, and of the same size.
#include "hxal/internal/option_rom.h"

#include <cstddef>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    for (const uint16_t devid : std::initializer_list<uint16_t>{0x13, 0x17})
    {
        hxal::Image rom(data, data + size);
        if (hxal::update_device_id_chksum(rom, devid) != HXA_STATUS_OK)
            continue;
        if (rom.size() != size)
            std::abort();
    }
    return 0;
}
