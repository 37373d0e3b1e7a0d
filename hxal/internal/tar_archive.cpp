#include "hxal/internal/tar_archive.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <optional>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace hxal
{

namespace
{

constexpr size_t block_size = 512;

struct Tar_Header
{
    char name[100];    //   0
    char mode[24];     // 100  mode, user id, group id
    char size[12];     // 124  octal text
    char rest[121];    // 136  time, checksum, type, link name
    char magic[5];     // 257  "ustar"
    char padding[250]; // 262
};
static_assert(sizeof(Tar_Header) == block_size);
static_assert(offsetof(Tar_Header, size) == 124);
static_assert(offsetof(Tar_Header, magic) == 257);

constexpr std::string_view magic = "ustar";

// Octal digits, with blanks before and a blank or zero bytes behind.
std::optional<uint64_t> octal(std::string_view text)
{
    text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
    const std::string_view digits = text.substr(0, text.find_first_of(std::string_view(" \0", 2)));
    if (digits.empty() || digits.find_first_not_of("01234567") != digits.npos)
        return std::nullopt;
    uint64_t value = 0;
    for (const char digit : digits)
        value = value << 3 | static_cast<uint64_t>(digit - '0');
    return value;
}

constexpr uint64_t padding_after(uint64_t size) { return (block_size - size % block_size) % block_size; }

} // namespace

bool Tar_Reader::holds(uint64_t size) const
{
    struct stat status;
    const off_t here = ::lseek(_fd, 0, SEEK_CUR);
    return here >= 0 && ::fstat(_fd, &status) == 0 && here <= status.st_size &&
           size <= static_cast<uint64_t>(status.st_size - here);
}

hxa_status_t Tar_Reader::next(Tar_Member& member)
{
    Tar_Header header;
    if (!read_all(_fd, &header, sizeof header) || std::string_view(header.magic, sizeof header.magic) != magic)
        return HXA_STATUS_BAD_FILE;
    const std::optional<uint64_t> size = octal({header.size, sizeof header.size});
    if (!size || !holds(*size))
        return HXA_STATUS_BAD_FILE;
    if (*size > max_image_size)
        return HXA_STATUS_ENOMEM;
    member.name.assign(header.name, ::strnlen(header.name, sizeof header.name));
    member.data.resize(*size);
    if (!read_all(_fd, member.data.data(), member.data.size()))
        return HXA_STATUS_BAD_FILE;
    // The last member's padding may be missing; whoever reads on finds the end of the file then.
    ::lseek(_fd, static_cast<off_t>(padding_after(*size)), SEEK_CUR);
    return HXA_STATUS_OK;
}

} // namespace hxal
