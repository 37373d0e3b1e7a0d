// A boot code archive in memory.
#pragma once

#include "hxal/internal/boot_description.h"

namespace hxal
{

// Reads all images of an archive, as boot.h has it, with the statuses that it names. A wrapped archive passes through
// "./zmlrtmpfile", which is never anybody else's file and is gone when this returns. Throws std::bad_alloc.
hxa_status_t read_boot_archive(const char* path, std::vector<HXAL_IMAGE_DATA_T>& images);

} // namespace hxal
