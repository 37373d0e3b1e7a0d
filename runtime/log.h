// The log: one line per event in ~/.cimple/messages, switched on by the option LOG_LEVEL of ~/.cimplerc and off otherwise.
//
// Lines of several threads and processes never mix. Logging never reports a failure; when it cannot be set up it is off.
#pragma once

#include "runtime/types.h"

#include <atomic>
#include <cstdarg>

namespace zmlr
{

enum Log_Level : uint32
{
    LL_FATAL = 0,
    LL_ERR = 1,
    LL_WARN = 2,
    LL_INFO = 3,
    LL_DBG = 4
};

// The highest level that is written, -1 when none is; LL_DBG until the first call has read the option file.
extern constinit std::atomic<int> _log_threshold;

// Whether a line of this level may have to be written: one relaxed load, so that a suppressed call formats nothing.
inline bool log_wanted(Log_Level level) { return static_cast<int>(level) <= _log_threshold.load(std::memory_order_relaxed); }

// Writes one line: local time, level name, "file(line): " and the formatted message. What others put into the message cannot
// leave the line or steer a terminal (text/safe_text.h), and no more than 16 KiB of it are written: whoever logs hands texts of
// clients and drivers over as they are. errno is left as it was.
[[gnu::format(printf, 4, 5)]] void log(Log_Level level, const char* file, int line, const char* format, ...) noexcept;
[[gnu::format(printf, 4, 0)]] void vlog(Log_Level level, const char* file, int line, const char* format,
                                        va_list arguments) noexcept;

// The runtime's own warnings: a call that remembers its place. It writes nothing while log_enable(false) holds.
struct Log_Call_Frame
{
    Log_Level level;
    const char* file;
    int line;

    [[gnu::format(printf, 2, 3)]] void invoke(const char* format, ...) const;
};

// Switches the runtime's own warnings (Log_Call_Frame); -1 when they already were in that state, else 0.
int log_enable(bool flag);
int log_set_level(const char* name); // -1 for an unknown level name
void open_log(const char* name);     // initialises with another directory name than ".cimple"

// The calling function's log line, for every source that names itself with a `log_source` constant:
// ZMLR_LOG(LL_INFO, "Number of Adapters: %d", count)
#define ZMLR_LOG(level, ...)                                                                                                     \
    do                                                                                                                           \
    {                                                                                                                            \
        if (::zmlr::log_wanted(level))                                                                                           \
            ::zmlr::log(level, log_source, __LINE__, __VA_ARGS__);                                                               \
    } while (false)

} // namespace zmlr
