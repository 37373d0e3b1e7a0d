#include "hxal/config/model.h"
#include "hxal/internal/application.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/internal/ioc_list.h"
#include "hxal/internal/memory.h"
#include "hxal/internal/request.h"
#include "hxal/library.h"

namespace
{

using hxal::Descriptor;
using hxal::Ioc_Node;

constexpr uint32_t max_instances = 128; // of one node

struct Device_Node
{
    const char (&path)[9];
    hxa_ioc_type_e type;
};

constexpr Device_Node fc_node{.path = "/dev/hxa", .type = HXA_IOC_TYPE_FC};
constexpr Device_Node ethernet_node{.path = "/dev/hxn", .type = HXA_IOC_TYPE_LL};

// The IOCs of the last scan.
constinit hxal::List<hxal_s> iocs;

// A handle to talk to a node before any IOC of it is known.
hxal_s probe_of(const Descriptor& descriptor, hxa_ioc_type_e type)
{
    hxal_s probe{};
    probe.fd = descriptor.number();
    probe.ioc_type = type;
    return probe;
}

bool is_present(const hxa_ioctl_ioc_get_inst_t& instances, uint32_t instance)
{
    return (instances.bm[instance / 8] >> instance % 8 & 1) != 0;
}

// A number that is no type becomes the type of the node, so that requests keep the group byte its driver understands.
hxa_ioc_type_e type_of(const hxa_ioctl_ioc_info_t& info, const Device_Node& node)
{
    if (info.ioc_type < HXA_IOC_TYPE_FC || info.ioc_type > HXA_IOC_TYPE_LL)
        return node.type;
    return static_cast<hxa_ioc_type_e>(info.ioc_type);
}

void fill_fc(hxal_s& ioc, const hxa_ioctl_ioc_info_t& info)
{
    ioc.pwwn = info.pwwn;
    ioc.nwwn = info.nwwn;
    ioc.factorypwwn = info.factorypwwn;
    ioc.factorynwwn = info.factorynwwn;
    hxal::copy_text(ioc.devpath, fc_node.path);
    if (hxal_config_ioc_lookup(ioc.pwwn) < 0)
        hxal_config_ioc_add(ioc.pwwn);
    if (ioc.ioc_type != HXA_IOC_TYPE_FCoE)
        return;
    ioc.mac = info.mac;
    ioc.factory_mac = info.factory_mac;
}

void fill_ethernet(hxal_s& ioc, const hxa_ioctl_ioc_info_t& info)
{
    ioc.mac = info.mac;
    ioc.factory_mac = info.factory_mac;
    ioc.current_mac = info.current_mac;
    hxal::copy_text(ioc.eth_name, info.eth_name);
    hxal::copy_text(ioc.devpath, ethernet_node.path);
    if (hxal_config_ethioc_lookup(ioc.mac) < 0)
        hxal_config_ethioc_add(ioc.mac);
}

void fill(hxal_s& ioc, const hxa_ioctl_ioc_info_t& info, const Device_Node& node)
{
    hxal::copy_text(ioc.serialnum, info.serialnum);
    hxal::copy_text(ioc.ioc_hwpath, info.hwpath);
    hxal::copy_text(ioc.adapter_hwpath, info.adapter_hwpath);
    hxal::copy_text(ioc.name, info.name);
    hxal::copy_text(ioc.port_name, info.port_name);
    ioc.ioc_type = type_of(info, node);
    if (ioc.ioc_type == HXA_IOC_TYPE_LL)
        fill_ethernet(ioc, info);
    else
        fill_fc(ioc, info);
}

// Asks for every instance that is present and lists it.
hxa_status_t list_instances(hxal::List<hxal_s>& found, const Device_Node& node, const std::shared_ptr<Descriptor>& descriptor,
                            const hxa_ioctl_ioc_get_inst_t& instances)
{
    hxal_s probe = probe_of(*descriptor, node.type);
    hxal_s** end = &found.head; // appending there need not walk the list
    int next_id = iocs.count;
    for (uint32_t instance = 0; instance < instances.cnt; ++instance)
    {
        if (!is_present(instances, instance))
            continue;
        probe.instance = static_cast<int>(instance);
        auto info = hxal::request_for<hxa_ioctl_ioc_info_t>(probe);
        if (hxal::send(probe, "IOCMD_IOC_GET_INFO", info) != HXA_STATUS_OK)
            return HXA_STATUS_EIO;
        if (info.status != HXA_STATUS_OK)
            return info.status;

        auto* ioc = new Ioc_Node{};
        hxal::list_append(*end, static_cast<hxal_s*>(ioc));
        end = &ioc->next;
        ioc->node = descriptor;
        ioc->fd = probe.fd;
        ioc->instance = probe.instance;
        ioc->id = next_id++;
        fill(*ioc, info, node);
    }
    return HXA_STATUS_OK;
}

// Lists the IOCs of one node; the count is the driver's own.
hxa_status_t scan_node(hxal::List<hxal_s>& found, const Device_Node& node)
{
    const auto descriptor = std::make_shared<Descriptor>(node.path);
    if (!descriptor->is_open())
        return HXA_STATUS_NO_DRIVER;

    const hxal_s probe = probe_of(*descriptor, node.type);
    if (const hxa_status_t refused = hxal_ioc_compare_versions(&probe); refused != HXA_STATUS_OK)
        return refused;

    hxa_ioctl_ioc_get_inst_t instances{};
    if (hxal::send(probe, "IOCMD_IOC_GET_INST", instances) != HXA_STATUS_OK || instances.cnt > max_instances)
        return HXA_STATUS_EIO;

    hxa_ioctl_aen_t sync{};
    sync.app_id = hxal::current_application();
    if (hxal::send(probe, "IOCMD_AEN_SYNC", sync) != HXA_STATUS_OK)
        return HXA_STATUS_EIO;

    found.count = static_cast<int>(instances.cnt);
    return list_instances(found, node, descriptor, instances);
}

// Adds what a node has to the list; a node that fails part-way adds nothing.
void add_node(const Device_Node& node)
{
    hxal::List<hxal_s> found;
    const hxa_status_t failed = hxal::within_memory([&] { return scan_node(found, node); });
    if (failed != HXA_STATUS_OK)
    {
        hxal_set_last_error(failed);
        return;
    }
    iocs.count += found.count;
    if (found.head)
        hxal::list_append(iocs.head, std::exchange(found.head, nullptr));
}

} // namespace

int hxal_ioc_scan(void)
{
    hxal::list_free(iocs.head);
    iocs.count = 0;
    add_node(fc_node);
    add_node(ethernet_node);
    return iocs.count;
}

int hxal_ioc_get_num(void) { return iocs.count; }

hxal_t* hxal_ioc_get_list(void) { return iocs.head; }

int hxal_ioc_get_inst_num(void)
{
    const Descriptor descriptor(fc_node.path);
    if (!descriptor.is_open())
        return -1;
    hxa_ioctl_ioc_get_inst_t instances{};
    if (hxal::send(probe_of(descriptor, fc_node.type), "IOCMD_IOC_GET_INST", instances) != HXA_STATUS_OK)
        return -1;
    return static_cast<int>(instances.cnt);
}

void hxal::keep_iocs() { iocs.is_kept = true; }

std::shared_ptr<Descriptor> hxal::descriptor_of(int fd)
{
    hxal_s* ioc = first_that(iocs.head, [=](const hxal_s& each) { return each.fd == fd; });
    return ioc ? static_cast<Ioc_Node*>(ioc)->node : nullptr;
}
