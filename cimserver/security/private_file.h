// Files that hold secrets or state of the server: private to its user, and never half written.
#pragma once

#include <cstddef>
#include <string>

namespace cimserver
{

// What nobody but the owner may do.
enum class File_Privacy
{
    owner_only,     // read or write
    group_may_read, // write; and of others also read
    all_may_read    // write
};

// The whole content of a regular file that belongs to the server's user or to root and is as private as asked. Throws
// std::runtime_error that names the file and what is wrong with it, also when it holds more than max_bytes.
std::string read_private_file(const std::string& file, std::size_t max_bytes, File_Privacy privacy = File_Privacy::owner_only);

// Puts the content into the file, mode 0600, or 0640 when the group of the old one could read it: whoever reads it sees the old
// content or the new one, whole, also after a power failure. Throws std::system_error that names the file; it is then as it was.
void write_private_file(const std::string& file, const std::string& content);

// Removes what a write to the file left behind that was cut off by the end of its process. No other process may be writing it.
void remove_unfinished_writes(const std::string& file);

// Makes the folder, mode 0700, unless it is there; its parent must exist. Throws std::runtime_error when it cannot be made, is
// no folder, belongs to neither the server's user nor root, or is less private than asked.
void make_private_folder(const std::string& folder, File_Privacy privacy);

// Keeps other processes that lock the same folder out, for a scope.
class Folder_Lock
{
public:
    enum class Wait
    {
        yes,
        no
    };

    // Throws std::system_error when the folder cannot be opened or, without waiting, is locked.
    Folder_Lock(const std::string& folder, Wait wait);
    ~Folder_Lock();
    Folder_Lock(const Folder_Lock&) = delete;
    Folder_Lock& operator=(const Folder_Lock&) = delete;

private:
    int _folder;
};

// The folder that a file lies in.
std::string folder_of(const std::string& file);

} // namespace cimserver
