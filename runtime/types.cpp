#include "runtime/types.h"

namespace zmlr
{

constinit const char* const type_name[num_types] = {"boolean", "uint8",  "sint8",  "uint16", "sint16", "uint32", "sint32",
                                                    "uint64",  "sint64", "real32", "real64", "char16", "string", "datetime"};

constinit const uint8 type_size[num_types] = {1, 1, 1, 2, 2, 4, 4, 8, 8, 4, 8, 2, sizeof(void*), sizeof(void*)};

} // namespace zmlr
