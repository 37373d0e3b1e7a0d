// Any text given as the description of a boot code archive: every image of it is complete, or the text is refused.
#include "hxal/internal/boot_description.h"

#include <cstddef>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    std::vector<hxal::HXAL_IMAGE_DATA_T> images;
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    if (hxal::read_boot_description(text, images) != HXA_STATUS_OK)
        return 0;
    for (const hxal::HXAL_IMAGE_DATA_T& image : images)
        if (image.idevice.empty() || image.iport.empty())
            std::abort();
    return 0;
}
