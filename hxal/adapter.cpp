#include "hxal/adapter.h"

#include "hxal/internal/adapter_list.h"
#include "hxal/internal/addresses.h"
#include "hxal/internal/fixed_text.h"

#include <algorithm>

namespace
{

using hxal::same_text;

template <typename Fits> hxal_adapter_t* first_adapter(Fits fits) { return hxal::first_that(hxal::adapter_list(), fits); }

unsigned index_of(const hxal_adapter_t* adapter) { return adapter ? static_cast<unsigned>(adapter->id) : 0; }

// The copy that fits with the lowest port number. Two copies of one port stand for the first: only that one can be looked up.
template <typename Fits> hxal_t* first_port(hxal_t* list, Fits fits)
{
    hxal_t* best = nullptr;
    for (hxal_t* ioc = list; ioc; ioc = ioc->next)
        if (fits(*ioc) && (!best || ioc->id < best->id) && hxal::find(list, ioc->id) == ioc)
            best = ioc;
    return best;
}

hxal_t* port_with_wwn(const hxal_adapter_t& adapter, wwn_t wwn)
{
    return first_port(adapter.fcioc_list, [=](const hxal_s& ioc) { return ioc.pwwn == wwn || ioc.nwwn == wwn; });
}

bool has_mac(const hxal_adapter_t& adapter, mac_t mac)
{
    const auto is_fcoe_with_mac = [=](const hxal_s& ioc)
    { return ioc.ioc_type == HXA_IOC_TYPE_FCoE && hxal::same_mac(ioc.mac, mac); };
    const auto is_with_mac = [=](const hxal_s& ioc) { return hxal::same_mac(ioc.mac, mac); };
    return first_port(adapter.fcioc_list, is_fcoe_with_mac) || first_port(adapter.ethioc_list, is_with_mac);
}

int port_of(const hxal_t* copy) { return copy ? copy->id : -1; }

hxal_t* first_of(hxal_t* list)
{
    hxal_t* port_0 = hxal::find(list, 0);
    return port_0 ? port_0 : list;
}

} // namespace

void hxal_adapter_lib_init(void) {}

hxal_adapter_t* hxal_adapter_open_idx(int ad) { return hxal_adapter_get_by_idx(ad); }
hxal_adapter_t* hxal_adapter_get_by_idx(int ad) { return hxal::find(hxal::adapter_list(), ad); }

hxal_adapter_t* hxal_adapter_lookup(const char* serial)
{
    return first_adapter([=](const hxal_adapter_t& ad) { return same_text(serial, ad.serial_num); });
}

int hxal_adapter_open_by_name(const char* name)
{
    const hxal_adapter_t* found =
        first_adapter([=](const hxal_adapter_t& ad) { return same_text(name, ad.serial_num) || same_text(name, ad.name); });
    return found ? found->id : 0;
}

unsigned hxal_adapter_get_idx_by_name(const char* name)
{
    return index_of(first_adapter([=](const hxal_adapter_t& ad) { return same_text(name, ad.name); }));
}

unsigned hxal_adapter_get_idx_by_sn(const char* serial) { return index_of(hxal_adapter_lookup(serial)); }

unsigned hxal_adapter_get_idx_by_hwpath(const char* hwpath)
{
    return index_of(first_adapter([=](const hxal_adapter_t& ad) { return same_text(hwpath, ad.adapter_hwpath); }));
}

int hxal_adapter_get_by_pwwn(wwn_t wwn)
{
    const hxal_adapter_t* found = first_adapter([=](const hxal_adapter_t& ad) { return port_with_wwn(ad, wwn) != nullptr; });
    return found ? found->id : -1;
}

int hxal_adapter_open_by_wwn(wwn_t wwn) { return std::max(hxal_adapter_get_by_pwwn(wwn), 0); }

unsigned hxal_adapter_get_by_mac(mac_t mac)
{
    return index_of(first_adapter([=](const hxal_adapter_t& ad) { return has_mac(ad, mac); }));
}

int hxal_adapter_get_ioc_idx_by_pwwn(int ad, wwn_t wwn)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    return adapter ? port_of(port_with_wwn(*adapter, wwn)) : -1;
}

int hxal_adapter_get_ioc_idx_by_mac(int ad, mac_t mac)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    if (!adapter)
        return -1;
    return port_of(first_port(adapter->ethioc_list, [=](const hxal_s& ioc) { return hxal::same_mac(ioc.mac, mac); }));
}

int hxal_adapter_get_ioc_idx_by_hwpath(int ad, const char* hwpath)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    if (!adapter)
        return -1;
    const auto fits = [=](const hxal_s& ioc) { return same_text(hwpath, ioc.ioc_hwpath); };
    const int fc_port = port_of(first_port(adapter->fcioc_list, fits));
    const int eth_port = port_of(first_port(adapter->ethioc_list, fits));
    return fc_port < 0 || eth_port < 0 ? std::max(fc_port, eth_port) : std::min(fc_port, eth_port);
}

int hxal_adapter_get_pcifn(wwn_t pwwn)
{
    const auto fits = [=](const hxal_s& ioc) { return ioc.pwwn == pwwn; };
    const hxal_adapter_t* found = first_adapter([=](const hxal_adapter_t& ad) { return first_port(ad.fcioc_list, fits); });
    return found ? port_of(first_port(found->fcioc_list, fits)) : -1;
}

hxal_t* hxal_adapter_get_fcioc(const hxal_adapter_t* ad, int port) { return ad ? hxal::find(ad->fcioc_list, port) : nullptr; }
hxal_t* hxal_adapter_get_ethioc(const hxal_adapter_t* ad, int port) { return ad ? hxal::find(ad->ethioc_list, port) : nullptr; }

hxal_t* hxal_adapter_get_ioc(const hxal_adapter_t* ad, int port)
{
    hxal_t* fc = hxal_adapter_get_fcioc(ad, port);
    return fc ? fc : hxal_adapter_get_ethioc(ad, port);
}

hxal_t* hxal_adapter_get_first_ioc(const hxal_adapter_t* ad)
{
    if (!ad)
        return nullptr;
    return first_of(ad->fcioc_list ? ad->fcioc_list : ad->ethioc_list);
}

hxal_t* hxal_adapter_get_port(int ad) { return hxal_adapter_get_first_ioc(hxal_adapter_open_idx(ad)); }

hxal_t* hxal_adapter_get_port_by_wwn(int ad, wwn_t wwn)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    const hxal_t* copy = adapter ? port_with_wwn(*adapter, wwn) : nullptr;
    return copy ? hxal_ioc_open_pwwn(copy->pwwn) : nullptr;
}

const char* hxal_adapter_get_fcioc_hwpath(const hxal_adapter_t* ad, int port)
{
    const hxal_t* ioc = hxal_adapter_get_fcioc(ad, port);
    return ioc ? ioc->ioc_hwpath : nullptr;
}

const char* hxal_adapter_get_ethioc_hwpath(const hxal_adapter_t* ad, int port)
{
    const hxal_t* ioc = hxal_adapter_get_ethioc(ad, port);
    return ioc ? ioc->ioc_hwpath : nullptr;
}

wwn_t hxal_adapter_get_ioc_pwwn(const hxal_adapter_t* ad, int port)
{
    return hxal_ioc_get_pwwn(hxal_adapter_get_fcioc(ad, port));
}

int hxal_adapter_get_num_ioc(int ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    return adapter ? adapter->ioccount : -1;
}

int hxal_adapter_get_num_port(int ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    return adapter ? adapter->port_count : -1;
}

const char* hxal_adapter_get_serial_num_by_idx(uint16_t ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    return adapter ? adapter->serial_num : nullptr;
}

hxa_boolean_t hxal_adapter_is_cna_capable(int ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    return adapter ? adapter->cna_capable : HXA_FALSE;
}

void hxal_adapter_get_serial_num(const hxal_adapter_t* ad, char* serial)
{
    if (ad)
        hxal::copy_serial_out(serial, ad->serial_num);
}

void hxal_adapter_get_model(const hxal_adapter_t* ad, char* model)
{
    if (ad)
        hxal::copy_out(model, ad->model_descr);
}

void hxal_adapter_get_hw_path(const hxal_adapter_t* ad, char* hwpath)
{
    if (ad)
        hxal::copy_out(hwpath, ad->adapter_hwpath);
}

void hxal_adapter_update_ioc(int ad, const hxal_t* ioc)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    if (!adapter || !ioc)
        return;
    hxal_t* copy = hxal::is_fc(*ioc) ? adapter->fcioc_list : adapter->ethioc_list;
    if (!copy)
        return;
    copy->fd = ioc->fd;
    if (auto descriptor = hxal::descriptor_of(ioc->fd))
        static_cast<hxal::Ioc_Node*>(copy)->node = std::move(descriptor);
}
