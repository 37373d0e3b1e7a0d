// The traces of the CMPI side, at LL_DBG under the source name CMPI_Adapter: every entry and exit with its answer.
#pragma once

#include <cmpidt.h>

namespace zmlr
{

// "enter: name()" and "return: name()" or "return: name(): code".
void ent(const char* name, int line = __builtin_LINE());
void ret(const char* name, int line = __builtin_LINE());
void ret(const char* name, CMPIrc rc, int line = __builtin_LINE());

// A free text.
[[gnu::format(printf, 2, 3)]] void trc(int line, const char* format, ...);

// The name of a CMPI return code; "CMPI_RC_ERR_FAILED" for one that has none.
const char* _rc_to_str(CMPIrc rc);

} // namespace zmlr
