#include "runtime/assert.h"

#include <cstdio>
#include <cstdlib>

namespace zmlr
{

void __cimple_assert(const char* file, int line, const char* function, const char* condition)
{
    std::fprintf(stderr, "%s(%d): %s(): assert: %s\n\n", file, line, function, condition);
    std::abort();
}

void __cimple_trace(const char* file, int line, const char* message)
{
    std::fprintf(stderr, "TRACE: %s(%d): %s\n", file, line, message);
}

} // namespace zmlr
