#include "hxal/ioc.h"

#include "hxal/internal/addresses.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/internal/list.h"

namespace
{

using hxal::same_text;

template <typename Fits> hxal_t* first_ioc(Fits fits) { return hxal::first_that(hxal_ioc_get_list(), fits); }

int id_of(const hxal_t* ioc) { return ioc ? ioc->id : -1; }
int instance_of(const hxal_t* ioc) { return ioc ? ioc->instance : -1; }

bool has_type(const hxal_s& ioc, hxa_ioc_type_e type)
{
    return type == HXA_IOC_TYPE_FC ? hxal::is_fc(ioc) : ioc.ioc_type == type;
}

} // namespace

hxal_t* hxal_ioc_open_idx(int idx)
{
    if (idx < 0 || idx >= hxal_ioc_get_num())
        return nullptr;
    return hxal::find(hxal_ioc_get_list(), idx);
}

hxal_t* hxal_ioc_open_hwpath(const char* hwpath)
{
    return first_ioc([=](const hxal_s& ioc) { return same_text(hwpath, ioc.ioc_hwpath); });
}

hxal_t* hxal_ioc_open_pwwn(wwn_t pwwn)
{
    return first_ioc([=](const hxal_s& ioc) { return hxal::is_fc(ioc) && ioc.pwwn == pwwn; });
}

hxal_t* hxal_ioc_open_name(const char* name)
{
    return first_ioc([=](const hxal_s& ioc) { return same_text(name, ioc.name); });
}

hxal_t* hxal_ioc_get_by_eth_name(const char* name)
{
    return first_ioc([=](const hxal_s& ioc) { return same_text(name, ioc.eth_name); });
}

hxal_t* hxal_ioc_get_by_inst(int instance)
{
    return first_ioc([=](const hxal_s& ioc) { return ioc.instance == instance; });
}

void hxal_ioc_close(hxal_t*) {}

int hxal_ioc_get_idx_by_pwwn(wwn_t pwwn) { return id_of(hxal_ioc_open_pwwn(pwwn)); }

int hxal_ioc_get_idx_by_mac(mac_t mac)
{
    return id_of(first_ioc([=](const hxal_s& ioc) { return ioc.ioc_type != HXA_IOC_TYPE_FC && hxal::same_mac(ioc.mac, mac); }));
}

int hxal_ioc_get_idx_by_name(const char* name, hxa_ioc_type_e type)
{
    return id_of(first_ioc([=](const hxal_s& ioc) { return has_type(ioc, type) && same_text(name, ioc.port_name); }));
}

int hxal_ioc_get_fc_idx_by_name(const char* name) { return hxal_ioc_get_idx_by_name(name, HXA_IOC_TYPE_FC); }
int hxal_ioc_get_eth_idx_by_name(const char* name) { return hxal_ioc_get_idx_by_name(name, HXA_IOC_TYPE_LL); }

int hxal_ioc_get_idx_by_hwpath(const char* hwpath, hxa_ioc_type_e type)
{
    return id_of(first_ioc([=](const hxal_s& ioc) { return has_type(ioc, type) && same_text(hwpath, ioc.ioc_hwpath); }));
}

int hxal_ioc_get_fc_idx_by_hwpath(const char* hwpath) { return hxal_ioc_get_idx_by_hwpath(hwpath, HXA_IOC_TYPE_FC); }
int hxal_ioc_get_eth_idx_by_hwpath(const char* hwpath) { return hxal_ioc_get_idx_by_hwpath(hwpath, HXA_IOC_TYPE_LL); }

int hxal_ioc_get_inst_num_by_pwwn(wwn_t pwwn) { return instance_of(hxal_ioc_open_pwwn(pwwn)); }

int hxal_ioc_get_inst_num_by_mac(mac_t mac)
{
    return instance_of(
        first_ioc([=](const hxal_s& ioc) { return ioc.ioc_type == HXA_IOC_TYPE_LL && hxal::same_mac(ioc.mac, mac); }));
}

void hxal_ioc_get_path(const hxal_t* ioc, char* devpath, char* hwpath, char* adapter_hwpath)
{
    if (!ioc)
        return;
    hxal::copy_out(devpath, ioc->devpath);
    hxal::copy_out(hwpath, ioc->ioc_hwpath);
    hxal::copy_out(adapter_hwpath, ioc->adapter_hwpath);
}

void hxal_ioc_get_path_by_idx(int idx, char* devpath) { hxal_ioc_get_path(hxal_ioc_open_idx(idx), devpath, nullptr, nullptr); }

wwn_t hxal_ioc_get_pwwn(const hxal_t* ioc) { return ioc ? ioc->pwwn : 0; }
wwn_t hxal_ioc_get_nwwn(const hxal_t* ioc) { return ioc ? ioc->nwwn : 0; }
mac_t hxal_ioc_get_mac(const hxal_t* ioc) { return ioc ? ioc->mac : mac_t{}; }
mac_t hxal_ioc_get_factory_mac(const hxal_t* ioc) { return ioc ? ioc->factory_mac : mac_t{}; }
int hxal_ioc_get_port_num(const hxal_t* ioc) { return ioc ? ioc->port_num : -1; }
hxa_ioc_type_e hxal_ioc_get_ioc_type(const hxal_t* ioc) { return ioc ? ioc->ioc_type : hxa_ioc_type_e{}; }
const char* hxal_ioc_get_name(const hxal_t* ioc) { return ioc ? ioc->port_name : nullptr; }
const char* hxal_ioc_get_eth_name(const hxal_t* ioc) { return ioc ? ioc->eth_name : nullptr; }
const char* hxal_ioc_get_sn(const hxal_t* ioc) { return ioc ? ioc->serialnum : nullptr; }
