#include "cimserver/security/user_file.h"

#include "cimserver/security/password_hash.h"
#include "cimserver/security/private_file.h"

#include <unistd.h>

#include <algorithm>
#include <sstream>
#include <stdexcept>

namespace cimserver
{
namespace
{

constexpr std::size_t max_name_bytes = 64;

bool has_control(const std::string& text)
{
    return std::any_of(text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; });
}

Users parse(const std::string& text, const std::string& file)
{
    Users users;
    std::istringstream lines(text);
    std::size_t number = 0;
    for (std::string line; std::getline(lines, line);)
    {
        ++number;
        const std::size_t colon = line.find(':');
        const std::string name = line.substr(0, colon);
        const std::string hash = colon == std::string::npos ? "" : line.substr(colon + 1);
        if (!is_user_name(name) || !is_password_hash(hash))
            throw std::runtime_error(file + " line " + std::to_string(number) + ": no user name with a yescrypt or SHA-512 hash");
        if (!users.emplace(name, hash).second)
            throw std::runtime_error(file + " line " + std::to_string(number) + ": " + name + " stands twice");
    }
    return users;
}

std::string format(const Users& users)
{
    std::string text;
    for (const auto& [name, hash] : users)
        text.append(name).append(":").append(hash).append("\n");
    return text;
}

} // namespace

bool is_user_name(const std::string& name)
{
    return !name.empty() && name.size() <= max_name_bytes && name.find(':') == std::string::npos && !has_control(name);
}

void check_password(const std::string& password)
{
    if (password.empty())
        throw std::runtime_error("the password is empty");
    if (password.size() > max_password_bytes)
        throw std::runtime_error("the password is longer than " + std::to_string(max_password_bytes) + " bytes");
    if (has_control(password))
        throw std::runtime_error("the password holds a control character");
}

Users read_users(const std::string& file)
{
    return parse(read_private_file(file, max_user_file_bytes, File_Privacy::group_may_read), file);
}

void store_user(const std::string& file, const std::string& name, const std::string& password)
{
    if (!is_user_name(name))
        throw std::runtime_error("a user name has 1 to 64 bytes, no colon and no control character");
    check_password(password);
    const std::string hash = hash_password(password);

    make_private_folder(folder_of(file), File_Privacy::all_may_read);
    const Folder_Lock lock(folder_of(file), Folder_Lock::Wait::yes); // two at once must not lose one
    Users users = access(file.c_str(), F_OK) == 0 ? read_users(file) : Users();
    users[name] = hash;
    const std::string text = format(users);
    if (text.size() > max_user_file_bytes)
        throw std::runtime_error(file + " is full");
    write_private_file(file, text);
}

} // namespace cimserver
