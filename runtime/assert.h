// Internal-consistency checks: for broken invariants only, never for what a client, a driver, a disk or a file can send.
#pragma once

namespace zmlr
{

// Writes "file(line): function(): assert: condition" and an empty line to standard error and aborts the process.
[[noreturn]] void __cimple_assert(const char* file, int line, const char* function, const char* condition);

// Writes "TRACE: file(line): message" to standard error.
void __cimple_trace(const char* file, int line, const char* message);

// Aborts through __cimple_assert unless the condition holds; `text` is the condition as the report shall quote it.
inline void check(bool condition, const char* text, const char* file = __builtin_FILE(), int line = __builtin_LINE(),
                  const char* function = __builtin_FUNCTION())
{
    if (!condition) [[unlikely]]
        __cimple_assert(file, line, function, text);
}

} // namespace zmlr
