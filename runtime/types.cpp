#include "runtime/types.h"

#include "runtime/string.h"

namespace zmlr
{

constinit const char* const type_name[num_types] = {"boolean", "uint8",  "sint8",  "uint16", "sint16", "uint32", "sint32",
                                                    "uint64",  "sint64", "real32", "real64", "char16", "string", "datetime"};

constinit const uint8 type_size[num_types] = {1, 1, 1, 2, 2, 4, 4, 8, 8, 4, 8, 2, sizeof(void*), sizeof(void*)};

int type_name_to_type(const char* name, Type& type)
{
    for (uint32 i = 0; i < num_types; ++i)
    {
        if (eqi(name, type_name[i]))
        {
            type = static_cast<Type>(i);
            return 0;
        }
    }
    return -1;
}

} // namespace zmlr
