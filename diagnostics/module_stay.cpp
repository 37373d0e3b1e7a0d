#include "diagnostics/module_stay.h"

#include "hxal/library.h"

#include <dlfcn.h>

namespace zmlr
{

bool stay_in_memory()
{
    static constinit bool stays = false;
    Dl_info own = {};
    if (stays)
        return true;
    if (dladdr(&stays, &own) == 0 || !dlopen(own.dli_fname, RTLD_NOW | RTLD_NOLOAD | RTLD_NODELETE))
        return false;
    hxal_libkeep();
    return stays = true;
}

} // namespace zmlr
