#include "providers/enumeration.h"

#include "inventory/fchba_manager.h"
#include "inventory/hdr_manager.h"
#include "profiles/server_manager.h"

#include <algorithm>

namespace zmlr
{

Instance_Array fchba_manager(classId_t id, const Inventory_Request& request)
{
    return FCHBAManager::getFCHBAManager().getInstances(id, request);
}

Instance_Array hdr_manager(classId_t id, const Inventory_Request& request)
{
    return HDRManager::getHDRManager().getInstances(id, request);
}

Instance_Array server_manager(classId_t id, const Inventory_Request& request)
{
    return ServerManager::getServerManager().getInstances(id, request);
}

void say(std::span<const Log_Row> lines, const char* log_source)
{
    for (const Log_Row& line : lines)
    {
        if (line.text)
            ZMLR_LOG(line.level, "%s", line.text);
    }
}

namespace
{

bool has(const Instance_Array& instances, const Instance* model)
{
    return std::ranges::any_of(instances, [model](const Instance* instance) { return key_eq(instance, model); });
}

Instance_Array read(const Enumeration& row, const Instance* wanted)
{
    Inventory_Request request;
    if (wanted && row.get_instances != server_manager) // which leaves nothing out, and need not be asked again
        request.wanted = Wanted(wanted);
    if (!request.wanted.is_all())
    {
        Instance_Array instances = row.get_instances(row.id, request);
        if (has(instances, wanted))
            return instances;
        request.wanted = Wanted();
    }
    return row.get_instances(row.id, request);
}

} // namespace

Instance_Array instances_of(const Enumeration& row, const Instance* wanted, const char* log_source)
{
    Instance_Array instances = read(row, wanted);
    if (!instances.empty())
    {
        ZMLR_LOG(LL_DBG, "Returning instances");
        return instances;
    }
    say(row.empty, log_source);
    return instances;
}

} // namespace zmlr
