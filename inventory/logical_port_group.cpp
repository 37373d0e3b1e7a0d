#include "inventory/logical_port_group.h"

#include "inventory/property_text.h"
#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "PortHelper";

} // namespace

Ref<ZEMLAR_LogicalPortGroup> getLogicalPortGroupInstance(const _hbaPortInfo& info)
{
    const Scope_Trace trace(log_source);
    const String host = property_text(info.host);

    Ref<ZEMLAR_LogicalPortGroup> group(ZEMLAR_LogicalPortGroup::create());
    group->InstanceID.set(info.node_wwn);
    group->Name.set(info.port_wwn);
    group->NameFormat.set("WWN");
    group->ElementName.set(String(info.node_wwn) + ":" + info.port_wwn);
    group->Caption.set(host);
    group->Description.set(host);
    ZMLR_LOG(LL_DBG, "returned Instance of getLogicalPortGroupInstance- port WWN= %s", info.port_wwn);
    return group;
}

} // namespace zmlr
