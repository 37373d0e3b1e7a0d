#include "cimserver/security/private_file.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <stdexcept>
#include <system_error>

namespace cimserver
{
namespace
{

[[noreturn]] void fail(const std::string& what, int error = errno)
{
    throw std::system_error(error, std::generic_category(), what);
}

class Descriptor
{
public:
    explicit Descriptor(int descriptor) : _descriptor(descriptor) {}
    ~Descriptor()
    {
        if (_descriptor >= 0)
            close(_descriptor);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    operator int() const { return _descriptor; }

private:
    int _descriptor;
};

struct Privacy_Row
{
    mode_t forbidden;
    const char* rule;
};

// In the order of File_Privacy.
constexpr Privacy_Row privacy_rows[] = {
    {077, "may be read or written by others than its owner: its mode must be 0600, a folder's 0700"},
    {027, "may be read by everybody or written by its group: its mode must be 0640 or 0600"},
    {022, "may be written by others than its owner"},
};

void check_private(const std::string& name, const struct stat& status, File_Privacy privacy)
{
    if (status.st_uid != geteuid() && status.st_uid != 0)
        throw std::runtime_error(name + " belongs to another user");
    const Privacy_Row& row = privacy_rows[static_cast<std::size_t>(privacy)];
    if ((status.st_mode & row.forbidden) != 0)
        throw std::runtime_error(name + " " + row.rule);
}

void write_all(int descriptor, const std::string& content, const std::string& file)
{
    for (std::size_t done = 0; done < content.size();)
    {
        const ssize_t written = write(descriptor, content.data() + done, content.size() - done);
        if (written < 0 && errno != EINTR)
            fail("cannot write " + file);
        if (written > 0)
            done += static_cast<std::size_t>(written);
    }
}

void sync_folder(const std::string& folder)
{
    const Descriptor descriptor(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (descriptor < 0 || fsync(descriptor) != 0)
        fail("cannot write " + folder);
}

constexpr std::string_view temporary_suffix = ".XXXXXX";

// A file of a name of its own, gone at the end of the scope unless it was renamed.
class Temporary_File
{
public:
    explicit Temporary_File(const std::string& target)
        : _name(target + std::string(temporary_suffix))
        , _descriptor(mkostemp(_name.data(), O_CLOEXEC))
    {
        if (_descriptor < 0)
            fail("cannot write " + target);
    }
    ~Temporary_File()
    {
        if (!_renamed)
            unlink(_name.c_str());
    }
    Temporary_File(const Temporary_File&) = delete;
    Temporary_File& operator=(const Temporary_File&) = delete;

    void write_and_rename(const std::string& content, const std::string& target)
    {
        take_group_of(target);
        write_all(_descriptor, content, target);
        if (fsync(_descriptor) != 0 || rename(_name.c_str(), target.c_str()) != 0)
            fail("cannot write " + target);
        _renamed = true;
    }

private:
    // Whoever could read the old file through its group can read the new one, unless this process may not give that group away.
    void take_group_of(const std::string& target)
    {
        struct stat status = {};
        if (stat(target.c_str(), &status) == 0 && (status.st_mode & S_IRGRP) != 0 &&
            fchown(_descriptor, static_cast<uid_t>(-1), status.st_gid) == 0 && fchmod(_descriptor, 0640) != 0)
            fail("cannot write " + target);
    }

    std::string _name;
    Descriptor _descriptor;
    bool _renamed = false;
};

} // namespace

std::string folder_of(const std::string& file)
{
    const std::string folder = std::filesystem::path(file).parent_path();
    return folder.empty() ? "." : folder;
}

// Opened without waiting: a FIFO in the file's place must not hold the server up.
std::string read_private_file(const std::string& file, std::size_t max_bytes, File_Privacy privacy)
{
    const Descriptor descriptor(open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    struct stat status = {};
    if (descriptor < 0 || fstat(descriptor, &status) != 0)
        fail("cannot read " + file);
    if (!S_ISREG(status.st_mode))
        throw std::runtime_error(file + " is no regular file");
    check_private(file, status, privacy);

    std::string content;
    char buffer[4096];
    for (;;)
    {
        const ssize_t count = read(descriptor, buffer, sizeof buffer);
        if (count < 0 && errno == EINTR)
            continue;
        if (count < 0)
            fail("cannot read " + file);
        if (count == 0)
            return content;
        content.append(buffer, static_cast<std::size_t>(count));
        if (content.size() > max_bytes)
            throw std::runtime_error(file + " is larger than " + std::to_string(max_bytes) + " bytes");
    }
}

void write_private_file(const std::string& file, const std::string& content)
{
    Temporary_File(file).write_and_rename(content, file);
    sync_folder(folder_of(file));
}

void remove_unfinished_writes(const std::string& file)
{
    const std::string start = std::filesystem::path(file).filename().string() + ".";
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(folder_of(file), error))
    {
        const std::string name = entry.path().filename();
        if (name.starts_with(start) && name.size() == start.size() - 1 + temporary_suffix.size())
            std::filesystem::remove(entry.path(), error);
    }
}

void make_private_folder(const std::string& folder, File_Privacy privacy)
{
    if (mkdir(folder.c_str(), 0700) != 0 && errno != EEXIST)
        fail("cannot make the folder " + folder);
    struct stat status = {};
    if (stat(folder.c_str(), &status) != 0)
        fail("cannot read " + folder);
    if (!S_ISDIR(status.st_mode))
        throw std::runtime_error(folder + " is no folder");
    check_private(folder, status, privacy);
}

Folder_Lock::Folder_Lock(const std::string& folder, Wait wait) : _folder(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC))
{
    if (_folder < 0)
        fail("cannot open the folder " + folder);
    const int how = wait == Wait::yes ? LOCK_EX : LOCK_EX | LOCK_NB;
    while (flock(_folder, how) != 0)
        if (errno != EINTR)
        {
            const int error = errno;
            close(_folder);
            fail("cannot lock the folder " + folder + ", another process uses it", error);
        }
}

Folder_Lock::~Folder_Lock() { close(_folder); }

} // namespace cimserver
