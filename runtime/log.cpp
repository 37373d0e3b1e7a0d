#include "runtime/log.h"

#include "runtime/buffer.h"
#include "runtime/datetime.h"
#include "runtime/file_lock.h"
#include "runtime/log_options.h"
#include "runtime/regular_file.h"
#include "runtime/string.h"
#include "text/safe_text.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace zmlr
{

constinit std::atomic<int> _log_threshold{LL_DBG};

namespace
{

constexpr const char* cimple_home_envvar = "HOME";
constexpr const char* default_name = ".cimple";
constexpr const char* level_names[] = {"FATAL", "ERR", "WARN", "INFO", "DBG"};
constexpr std::size_t path_size = 1024;
constexpr std::size_t longest_message = 16 * 1024; // bytes

// Other modules log from their static initialisers and destructors: nothing here is constructed or destroyed at run time.
constinit std::mutex _mutex;
constinit bool _initialized = false;
constinit Log_Level _level = LL_FATAL;
constinit int _os = -1;
constinit File_Lock* _lock = nullptr;
constinit std::atomic<bool> _log_enabled_state{true};

// Writes the joined texts; false when they do not fit.
[[gnu::format(printf, 2, 3)]] bool make_path(char (&path)[path_size], const char* format, ...)
{
    va_list arguments;
    va_start(arguments, format);
    const int length = std::vsnprintf(path, path_size, format, arguments);
    va_end(arguments);
    return length >= 0 && static_cast<std::size_t>(length) < path_size;
}

bool parse_level(const char* name, Log_Level& level)
{
    for (uint32 i = LL_FATAL; i <= LL_DBG; ++i)
    {
        if (eqi(name, level_names[i]))
        {
            level = static_cast<Log_Level>(i);
            return true;
        }
    }
    return false;
}

bool read_level(const char* home, const char* name)
{
    char path[path_size];
    char value[option_line_size];
    return make_path(path, "%s/%src", home, name) && _get_opt_value(path, "LOG_LEVEL", value) && parse_level(value, _level);
}

// Opens the lock, then the log. Only both together are of use.
void open_files(const char* home, const char* name)
{
    char directory[path_size];
    char messages[path_size];
    char messages_lock[path_size];
    if (!make_path(directory, "%s/%s", home, name) || !make_path(messages, "%s/messages", directory) ||
        !make_path(messages_lock, "%s/messages.lock", directory))
        return;

    mkdir(directory, 0777);
    std::unique_ptr<File_Lock> lock(new (std::nothrow) File_Lock(messages_lock));
    if (!lock || !lock->okay())
        return;
    _os = open_regular(messages, O_WRONLY | O_APPEND | O_CREAT, 0644);
    if (_os >= 0)
        _lock = lock.release();
}

void publish_threshold() { _log_threshold.store(_os < 0 ? -1 : static_cast<int>(_level), std::memory_order_relaxed); }

// Tried once: whatever keeps the log from working now keeps it off. The caller holds the mutex.
void initialise(const char* name) noexcept
{
    if (_initialized)
        return;
    _initialized = true;

    const char* home = std::getenv(cimple_home_envvar);
    if (home && read_level(home, name))
        open_files(home, name);
    publish_threshold();
}

void write_all(const char* text, std::size_t size)
{
    while (size > 0)
    {
        const ssize_t written = write(_os, text, size);
        if (written < 0 && errno != EINTR)
            return;
        const auto n = static_cast<std::size_t>(written < 0 ? 0 : written);
        text += n;
        size -= n;
    }
}

// A message as one line, whatever clients, drivers and disks have put into it. Some formats end with a line feed, and one has a
// tab.
[[gnu::format(printf, 1, 0)]] std::string line_of(const char* format, va_list arguments)
{
    Buffer buffer;
    buffer.vformat(format, arguments);
    std::string_view message(buffer.data(), buffer.size());
    if (message.ends_with('\n'))
        message.remove_suffix(1);
    return text::safe_text(message.substr(0, longest_message), "\t") + '\n';
}

[[gnu::format(printf, 4, 0)]] void write_line(Log_Level level, const char* file, int line, const char* format, va_list arguments)
{
    char time[Datetime::pretty_text_size];
    Datetime::now().ascii(time, true);
    time[std::strcspn(time, ".")] = '\0';

    Buffer buffer;
    buffer.format("%s %s: %s(%d): ", time, level_names[level], file, line);
    const std::string message = line_of(format, arguments);
    buffer.append(message.data(), message.size());

    _lock->lock();
    write_all(buffer.data(), buffer.size());
    _lock->unlock();
}

// Runs after every static destructor of the module, when the process ends or the module is unloaded; lines that come
// later still are dropped.
[[gnu::destructor(101)]] void close_log()
{
    const std::lock_guard guard(_mutex);
    _initialized = true;
    if (_os >= 0)
        close(_os);
    _os = -1;
    delete std::exchange(_lock, nullptr);
    publish_threshold();
}

} // namespace

void log(Log_Level level, const char* file, int line, const char* format, ...) noexcept
{
    va_list arguments;
    va_start(arguments, format);
    vlog(level, file, line, format, arguments);
    va_end(arguments);
}

void vlog(Log_Level level, const char* file, int line, const char* format, va_list arguments) noexcept
{
    if (!log_wanted(level))
        return;

    const int saved_errno = errno;
    try
    {
        const std::lock_guard guard(_mutex);
        initialise(default_name);
        if (_os >= 0 && level <= _level)
            write_line(level, file, line, format, arguments);
    }
    catch (...)
    {
        // Without memory for it the line is lost; whoever logs has more important things to do.
    }
    errno = saved_errno;
}

void Log_Call_Frame::invoke(const char* format, ...) const
{
    if (!_log_enabled_state.load(std::memory_order_relaxed))
        return;
    va_list arguments;
    va_start(arguments, format);
    vlog(level, file, line, format, arguments);
    va_end(arguments);
}

int log_enable(bool flag) { return _log_enabled_state.exchange(flag) == flag ? -1 : 0; }

int log_set_level(const char* name)
{
    const std::lock_guard guard(_mutex);
    if (!parse_level(name, _level))
        return -1;
    if (_initialized)
        publish_threshold();
    return 0;
}

void open_log(const char* name)
{
    const std::lock_guard guard(_mutex);
    initialise(name);
}

} // namespace zmlr
