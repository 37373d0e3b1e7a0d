// The bytes of a flash image, and the files that they come from and go to.
#pragma once

#include "hxal/records/status.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace hxal
{

using Image = std::vector<uint8_t>;

// No card holds as much: whatever claims to be larger is not worth the memory.
constexpr size_t max_image_size = 64 * 1024 * 1024;

// Reads `size` bytes, or writes them, from where the file stands. False when there are fewer, or the file fails.
bool read_all(int fd, void* to, size_t size);
bool write_all(int fd, const void* from, size_t size);

// The bytes of a whole regular file. HXA_STATUS_FAILED when it does not exist or yields nothing, HXA_STATUS_EFOPEN when it
// cannot be opened, HXA_STATUS_ENOMEM when it is larger than max_image_size. Throws std::bad_alloc.
hxa_status_t read_image_file(const char* path, Image& image);

// Creates or replaces a file. HXA_STATUS_EFOPEN when it cannot be opened, HXA_STATUS_FAILED when it cannot be written.
hxa_status_t write_image_file(const char* path, const Image& image);

} // namespace hxal
