// Any file given as a boot code archive: read or refused, and what was read is within what it holds.
#include "hxal/internal/boot_archive.h"

#include <cstddef>
#include <cstdio>
#include <cstdlib>
#include <sys/mman.h>
#include <unistd.h>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    static const int file = memfd_create("archive", 0);
    static char path[32];
    std::snprintf(path, sizeof path, "/proc/self/fd/%d", file);
    if (ftruncate(file, 0) != 0 || pwrite(file, data, size, 0) != static_cast<ssize_t>(size))
        std::abort();

    std::vector<hxal::HXAL_IMAGE_DATA_T> images;
    if (hxal::read_boot_archive(path, images) != HXA_STATUS_OK)
        return 0;
    size_t total = 0;
    for (const hxal::HXAL_IMAGE_DATA_T& image : images)
        total += image.ibuf.size();
    if (images.empty() || total > size)
        std::abort();
    return 0;
}
