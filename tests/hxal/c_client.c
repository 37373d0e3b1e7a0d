// A client in C: scans the host and prints its adapters. It fails when the host is not the one of c_client.json.
#include "hxal/hxal.h"

#include <stdio.h>

static void print_port(const hxal_adapter_t* adapter, int port)
{
    const hxal_t* ioc = hxal_adapter_get_ioc(adapter, port);
    hxa_pport_attr_t attr;
    if (hxal_port_get_attr(ioc, &attr) == HXA_STATUS_OK)
        printf("  port %d: %s, %s\n", port, hxal_pport_states_to_string(attr.port_state), hxal_pport_speed_to_string(attr.speed));
}

static void print_adapter(int ad)
{
    const hxal_adapter_t* adapter = hxal_adapter_open_idx(ad);
    printf("%d: %s %s, %d IOCs\n", ad, adapter->serial_num, adapter->model_descr, adapter->ioccount);
    for (int port = 0; port < hxal_adapter_get_num_port(ad); ++port)
        print_port(adapter, port);
}

int main(void)
{
    hxal_libinit(hxa_aen_app_test);
    const int count = hxal_adapter_scan();
    if (count == 0)
        fprintf(stderr, "%s\n", hxal_status_to_string((int)hxal_get_last_error()));
    for (int ad = 1; ad <= count; ++ad)
        print_adapter(ad);
    hxal_libexit();
    return count == 2 && hxal_adapter_get_num_ioc(2) == 4 ? 0 : 1;
}
