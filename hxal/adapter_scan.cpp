#include "hxal/adapter.h"
#include "hxal/config/model.h"
#include "hxal/internal/adapter_list.h"
#include "hxal/internal/addresses.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/internal/memory.h"
#include "hxal/library.h"

#include <algorithm>

namespace
{

using hxal::Ioc_Node;

using Adapter_List = hxal::List<hxal_adapter_t>;

// The adapters of the last scan.
constinit Adapter_List adapters;

hxal_t*& list_for(hxal_adapter_t& adapter, const hxal_s& ioc)
{
    return hxal::is_fc(ioc) ? adapter.fcioc_list : adapter.ethioc_list;
}

void add_copy(hxal_adapter_t& adapter, const hxal_s& ioc)
{
    auto* copy = new Ioc_Node(static_cast<const Ioc_Node&>(ioc));
    copy->id = ioc.port_num;
    copy->next = nullptr;
    hxal::list_append(list_for(adapter, ioc), static_cast<hxal_s*>(copy));
    ++adapter.ioccount;
}

hxal_adapter_t& add_adapter(Adapter_List& list, const hxal_s& ioc, const hxa_ioc_attr_t& attr)
{
    auto* adapter = new hxal_adapter_t{};
    hxal::list_append(list.head, adapter);
    adapter->id = ++list.count;
    hxal::copy_text(adapter->serial_num, ioc.serialnum);
    if (hxal_config_ad_lookup(adapter->serial_num) < 0)
        hxal_config_ad_add(adapter->serial_num);
    hxal::copy_text(adapter->model_descr, attr.adapter_attr.model_descr);
    hxal::copy_text(adapter->adapter_hwpath, ioc.adapter_hwpath);
    adapter->cna_capable = attr.adapter_attr.cna_capable ? HXA_TRUE : HXA_FALSE;
    return *adapter;
}

void group(Adapter_List& list, const hxal_s& ioc, const hxa_ioc_attr_t& attr, const hxa_ioctl_ioc_info_t& info)
{
    hxal_adapter_t* adapter = hxal::first_that(list.head, [&](const hxal_adapter_t& each)
                                               { return hxal::same_text(ioc.adapter_hwpath, each.adapter_hwpath); });
    // The IOC that founds the adapter names it when it drives port 0; later ones when they are PCI function 0.
    const bool names_it = adapter ? attr.pci_attr.pcifn == 0 : ioc.port_num == 0;
    if (!adapter)
        adapter = &add_adapter(list, ioc, attr);
    if (names_it)
        hxal::copy_text(adapter->name, info.name);
    adapter->port_count = std::max(adapter->port_count, ioc.port_num + 1);
    add_copy(*adapter, ioc);
}

// Asks an IOC what it is and puts it into its adapter.
hxa_status_t add_ioc(Adapter_List& list, hxal_s& ioc)
{
    hxa_ioc_attr_t attr;
    if (const hxa_status_t failed = hxal_ioc_get_attr(&ioc, &attr); failed != HXA_STATUS_OK)
        return failed;
    ioc.port_num = attr.port_id;
    hxa_ioctl_ioc_info_t info;
    if (const hxa_status_t failed = hxal_ioc_get_info(&ioc, &info); failed != HXA_STATUS_OK)
        return failed;
    group(list, ioc, attr, info);
    return HXA_STATUS_OK;
}

// Groups all IOCs. One that fails leaves no adapter, and so does an index without an IOC, which is nobody's failure. Indexes only
// grow along the IOC list.
hxa_status_t group_all(int ioc_count)
{
    Adapter_List found;
    hxal_t* ioc = hxal_ioc_get_list();
    for (int idx = 0; idx < ioc_count; ++idx, ioc = ioc->next)
    {
        if (!ioc || ioc->id != idx)
            return HXA_STATUS_OK;
        if (const hxa_status_t failed = add_ioc(found, *ioc); failed != HXA_STATUS_OK)
            return failed;
    }
    adapters = std::move(found);
    return HXA_STATUS_OK;
}

} // namespace

int hxal_adapter_scan(void)
{
    const int ioc_count = hxal_ioc_scan();
    adapters.count = 0;
    hxal::list_free(adapters.head);
    if (const hxa_status_t failed = hxal::within_memory([=] { return group_all(ioc_count); }); failed != HXA_STATUS_OK)
        hxal_set_last_error(failed);
    return adapters.count;
}

hxal_adapter_t* hxal::adapter_list() { return adapters.head; }
void hxal::keep_adapters() { adapters.is_kept = true; }

unsigned hxal_adapter_get_num(void) { return static_cast<unsigned>(adapters.count); }
unsigned hxal_adapter_get_count(void) { return hxal_adapter_get_num(); }
