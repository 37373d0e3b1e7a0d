#include "hxal/internal/image.h"

#include "hxal/internal/descriptor.h"
#include "hxal/internal/regular_file.h"
#include "hxal/internal/size_limit.h"

#include <cerrno>

namespace hxal
{

namespace
{

// read(2) or write(2) until everything moved.
template <typename Call, typename Bytes> bool move_all(Call call, int fd, Bytes* bytes, size_t size)
{
    while (size > 0)
    {
        const ssize_t moved = call(fd, bytes, size);
        if (moved < 0 && errno == EINTR)
            continue;
        if (moved <= 0)
            return false;
        bytes += moved;
        size -= static_cast<size_t>(moved);
    }
    return true;
}

} // namespace

bool read_all(int fd, void* to, size_t size) { return move_all(::read, fd, static_cast<uint8_t*>(to), size); }

bool write_all(int fd, const void* from, size_t size)
{
    const Size_Limit_Without_Signal no_signal;
    return move_all(::write, fd, static_cast<const uint8_t*>(from), size);
}

hxa_status_t read_image_file(const char* path, Image& image)
{
    const Regular_File file(path);
    if (!file.is_regular() || file.size() == 0)
        return HXA_STATUS_FAILED;
    if (!file.is_open())
        return HXA_STATUS_EFOPEN;
    if (static_cast<uint64_t>(file.size()) > max_image_size)
        return HXA_STATUS_ENOMEM;
    image.resize(static_cast<size_t>(file.size()));
    return read_all(file.number(), image.data(), image.size()) ? HXA_STATUS_OK : HXA_STATUS_FAILED;
}

hxa_status_t write_image_file(const char* path, const Image& image)
{
    const Descriptor file(path, O_WRONLY | O_CREAT | O_TRUNC, S_IRUSR | S_IWUSR);
    if (!file.is_open())
        return HXA_STATUS_EFOPEN;
    return write_all(file.number(), image.data(), image.size()) ? HXA_STATUS_OK : HXA_STATUS_FAILED;
}

} // namespace hxal
