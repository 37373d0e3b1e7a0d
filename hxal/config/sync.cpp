// Replacing the file, so that at every moment either the old or the new one is there, whole.
#include "hxal/config/writer.h"

#include "hxal/internal/memory.h"
#include "hxal/internal/size_limit.h"

#include <cerrno>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <linux/magic.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>
#include <utility>

namespace
{

// What is at a path now.
struct Old_File
{
    bool can_be_replaced = false;
    bool exists = false;
    struct stat status = {};
};

bool reaches_nothing(const char* path)
{
    struct stat status;
    return ::lstat(path, &status) != 0 && errno == ENOENT;
}

// The path behind all links, or the path itself where nothing is yet. A link that leads nowhere has none.
bool resolve(const char* path, char (&target)[PATH_MAX])
{
    if (::realpath(path, target))
        return true;
    const std::size_t length = std::strlen(path);
    if (!reaches_nothing(path) || length >= sizeof target)
        return false;
    std::memcpy(target, path, length + 1);
    return true;
}

// Whether a path is, or leads by links to, one of the kernel's links to what processes have open: "/dev/stdout", for one. What
// lies behind it is somebody's terminal or log.
bool names_an_open_file(std::filesystem::path link)
{
    constexpr int most_links = 40; // as the kernel follows
    for (int links = 0; links < most_links; ++links)
    {
        std::error_code error;
        const std::filesystem::path target = std::filesystem::read_symlink(link, error);
        if (error)
            return false;
        const std::filesystem::path directory = link.has_parent_path() ? link.parent_path() : ".";
        struct statfs system = {};
        if (::statfs(directory.c_str(), &system) == 0 && system.f_type == PROC_SUPER_MAGIC)
            return true;
        link = directory / target;
    }
    return true;
}

// Opened for writing, because that is the permission asked for, but not written. Not blocking: it may be a FIFO.
Old_File look_at(const char* target)
{
    const int descriptor = ::open(target, O_WRONLY | O_CLOEXEC | O_NOCTTY | O_NOFOLLOW | O_NONBLOCK);
    if (descriptor < 0)
        return {.can_be_replaced = errno == ENOENT};
    Old_File old = {.exists = true};
    old.can_be_replaced = ::fstat(descriptor, &old.status) == 0 && S_ISREG(old.status.st_mode);
    ::close(descriptor);
    return old;
}

// A file of a new name beside the target, removed unless it takes the target's place.
class Temporary_File
{
public:
    explicit Temporary_File(const char* target)
    {
        std::snprintf(name, sizeof name, "%s.XXXXXX", target);
        const int descriptor = ::mkostemp(name, O_CLOEXEC);
        if (descriptor < 0)
            return;
        made = true;
        file = ::fdopen(descriptor, "w");
        if (!file)
            ::close(descriptor);
    }

    ~Temporary_File()
    {
        const int error = errno;
        if (file)
            std::fclose(file);
        if (made)
            ::unlink(name);
        errno = error;
    }

    Temporary_File(const Temporary_File&) = delete;
    Temporary_File& operator=(const Temporary_File&) = delete;

    std::FILE* stream() const { return file; }

    bool take_owner_and_mode(const struct stat& old) const
    {
        return ::fchown(::fileno(file), old.st_uid, old.st_gid) == 0 && ::fchmod(::fileno(file), old.st_mode & 07777) == 0;
    }

    bool replace(const char* target)
    {
        const bool flushed = std::fflush(file) == 0 && !std::ferror(file) && ::fsync(::fileno(file)) == 0;
        const bool closed = std::fclose(std::exchange(file, nullptr)) == 0;
        made = !(flushed && closed && ::rename(name, target) == 0);
        return !made;
    }

private:
    char name[PATH_MAX + sizeof ".XXXXXX"] = {};
    bool made = false;
    std::FILE* file = nullptr;
};

// Makes the new name last through a crash. The file is whole either way.
void flush_directory_of(char (&target)[PATH_MAX])
{
    char* slash = std::strrchr(target, '/');
    if (slash)
        slash[slash == target ? 1 : 0] = '\0';
    const int descriptor = ::open(slash ? target : ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (descriptor < 0)
        return;
    ::fsync(descriptor);
    ::close(descriptor);
}

bool is_full(int error) { return error == ENOSPC || error == EDQUOT; }

hxa_status_t replace_file(const char* path)
{
    char target[PATH_MAX];
    if (!path || !*path || names_an_open_file(path) || !resolve(path, target))
        return HXA_STATUS_EFOPEN;
    const Old_File old = look_at(target);
    if (!old.can_be_replaced)
        return HXA_STATUS_EFOPEN;

    const hxal::Size_Limit_Without_Signal no_signal;
    Temporary_File temporary(target);
    if (!temporary.stream())
        return is_full(errno) ? HXA_STATUS_FAILED : HXA_STATUS_EFOPEN;
    hxal_config_ad_update(temporary.stream());
    hxal_config_ioc_update(temporary.stream());
    if (old.exists && !temporary.take_owner_and_mode(old.status))
        return HXA_STATUS_FAILED;
    if (!temporary.replace(target))
        return HXA_STATUS_FAILED;
    flush_directory_of(target);
    return HXA_STATUS_OK;
}

} // namespace

hxa_status_t hxal_config_sync(const char* path)
{
    return hxal::within_memory([=] { return replace_file(path); });
}
