#include "providers/enumerate.h"

#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"

namespace zmlr
{

Instance_Array from_fchba_manager(classId_t id) { return FCHBAManager::getFCHBAManager().getInstances(id); }
Instance_Array from_hdr_manager(classId_t id) { return HDRManager::getHDRManager().getInstances(id); }

void log_empty(const Enumeration& source)
{
    const char* const log_source = source.log_source;
    ZMLR_LOG(LL_ERR, "%s", source.empty_message);
    if (source.empty_remark)
        ZMLR_LOG(LL_ERR, "%s", source.empty_remark);
}

} // namespace zmlr
