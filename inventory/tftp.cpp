#include "inventory/tftp.h"

#include "inventory/shell_command.h"
#include "runtime/trace.h"
#include "text/safe_text.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>
#include <string>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "ProviderUtil";
constexpr std::chrono::seconds removal_limit{30};
constexpr std::chrono::minutes transfer_limit{5};
constexpr int no_transfer = -1;

// One word of a shell command, whatever it holds.
std::string quoted(const char* word)
{
    std::string result = "'";
    for (; *word; word++)
        result += *word == '\'' ? std::string("'\\''") : std::string(1, *word);
    return result + "'";
}

struct Commands
{
    char remove[1024];
    char get[1024];

    // False when one is too long.
    bool fill(const char* server, const char* file)
    {
        const std::string to = quoted(server);
        const std::string name = quoted(file);
        const int remove_size = std::snprintf(remove, sizeof remove, "rm -f %s", name.c_str());
        const int get_size = std::snprintf(get, sizeof get, "tftp %s -c get %s", to.c_str(), name.c_str());
        return remove_size < static_cast<int>(sizeof remove) && get_size < static_cast<int>(sizeof get);
    }
};

// Whether a command takes the word for what it is.
bool is_plain(const String& word)
{
    return !word.empty() && word[0] != '-' && !text::holds_steering({word.c_str(), word.size()});
}

// The client takes what stands before a ':' for another server, and stores "folder/file" as "file". Where the working directory
// is somebody's home, files that begin with '.' are run at the next start of a shell.
bool is_file_name(const String& word)
{
    return is_plain(word) && word[0] != '.' && !std::strpbrk(word.c_str(), "/:") && !std::strstr(word.c_str(), "..");
}

bool is_address(const Tftp_Address& address)
{
    Commands commands;
    return is_plain(address.server) && is_file_name(address.file) && commands.fill(address.server.c_str(), address.file.c_str());
}

bool stands_there(const char* file)
{
    struct stat status;
    return lstat(file, &status) == 0;
}

bool is_empty_or_no_file(const char* file)
{
    struct stat status;
    return lstat(file, &status) == 0 && (!S_ISREG(status.st_mode) || status.st_size == 0);
}

} // namespace

std::optional<Tftp_Address> parse_tftp_address(const String& text)
{
    const uint32 slash = text.find('/');
    if (slash == String::npos || slash <= 1)
        return std::nullopt;
    Tftp_Address address = {text.substr(0, slash), text.substr(slash + 1)};
    return is_address(address) ? std::optional(std::move(address)) : std::nullopt;
}

int ProviderUtil::TftpGetFile(const char* server, const char* file)
{
    const Scope_Trace trace(log_source);
    Commands commands;
    if (!is_address({server, file}) || !commands.fill(server, file))
        return no_transfer;
    run_shell_command(commands.remove, removal_limit);
    if (stands_there(file))
        return no_transfer;
    int status = run_shell_command(commands.get, transfer_limit);
    if (status == 0 && is_empty_or_no_file(file))
        status = no_transfer;
    if (status != 0)
        unlink(file);
    return status;
}

Fetched_File::~Fetched_File()
{
    if (!name.empty())
        unlink(name.c_str());
}

} // namespace zmlr
