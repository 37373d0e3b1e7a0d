// Files that hold secrets or state of the server: private to its user, and never half written.
#pragma once

#include <cstddef>
#include <string>

namespace cimserver
{

enum class File_Privacy
{
    owner_only,    // neither the group nor others may read or write it
    group_may_read // others may not, the group may not write
};

// The whole content of a regular file that belongs to the server's user or to root and is as private as asked. Throws
// std::runtime_error that names the file and what is wrong with it, also when it holds more than max_bytes.
std::string read_private_file(const std::string& file, std::size_t max_bytes, File_Privacy privacy = File_Privacy::owner_only);

// Puts the content into the file, mode 0600: whoever reads it sees the old content or the new one, whole, also after a power
// failure. Throws std::system_error that names the file; it is then as it was.
void write_private_file(const std::string& file, const std::string& content);

// Makes the folder, mode 0700, unless it is there; its parent must exist. Throws std::runtime_error when it cannot be made, is
// no folder, belongs to neither the server's user nor root, or may be written by anybody else.
void make_private_folder(const std::string& folder);

// Keeps other processes that lock the same folder out, for a scope. Waits for them. Throws std::system_error.
class Folder_Lock
{
public:
    explicit Folder_Lock(const std::string& folder);
    ~Folder_Lock();
    Folder_Lock(const Folder_Lock&) = delete;
    Folder_Lock& operator=(const Folder_Lock&) = delete;

private:
    int _folder;
};

// The folder that a file lies in.
std::string folder_of(const std::string& file);

} // namespace cimserver
