#include "hxal/fcpt.h"
#include "hxal/internal/fixed_text.h"
#include "hxal/lport.h"
#include "hxal/rport.h"

namespace
{

// FC-GS-6: get symbolic port name by port identifier.
constexpr uint8_t directory_service = 0xFC;
constexpr uint8_t name_server = 0x02;
constexpr uint8_t gspn_id[] = {0x01, 0x18};
constexpr uint8_t ct_accept[] = {0x80, 0x02};

constexpr uint32_t timeout = 20; // seconds

struct Request
{
    fc_ct_header_t header;
    uint8_t rsvd;
    uint8_t port_id[3];
};
static_assert(sizeof(Request) == 20);

struct Response
{
    fc_ct_header_t header;
    uint8_t length; // of the name
    char name[495]; // longer than any name: a length that lies stays inside
};
static_assert(sizeof(Response) == 512);

template <std::size_t Size> void put_bytes(uint8_t (&field)[Size], const uint8_t (&bytes)[Size])
{
    std::memcpy(field, bytes, Size);
}

// The driver keeps an FC address so that its bytes in memory are those of the wire.
void put_address(uint8_t (&field)[3], uint32_t address) { std::memcpy(field, &address, sizeof field); }

fchs_t frame_header_from(uint32_t pid)
{
    fchs_t header{};
    header.r_ctl = 0x02;                        // unsolicited control
    put_bytes(header.d_id, {0xFF, 0xFF, 0xFC}); // the directory server
    put_address(header.s_id, pid);
    header.type = 0x20;                          // Fibre Channel services
    put_bytes(header.f_ctl, {0x29, 0x00, 0x00}); // first sequence, its last frame, initiative goes over
    put_bytes(header.rx_id, {0xFF, 0xFF});       // given by the responder
    return header;
}

Request query_for(uint32_t rport_pid)
{
    Request request{};
    request.header.revision = 0x01;
    request.header.gs_type = directory_service;
    request.header.gs_subtype = name_server;
    put_bytes(request.header.command, gspn_id);
    put_address(request.port_id, rport_pid);
    return request;
}

bool is_accept(const Response& response) { return std::memcmp(response.header.command, ct_accept, sizeof ct_accept) == 0; }

} // namespace

hxa_status_t hxal_get_rport_symname(const hxal_t* ioc, uint16_t vf_id, uint32_t rport_pid, wwn_t lpwwn, wwn_t rpwwn,
                                    hxa_rport_symname_t* symname)
{
    if (!symname)
        return HXA_STATUS_EINVAL;
    hxa_port_attr_t lport;
    if (const hxa_status_t status = hxal_lport_get_attr(ioc, vf_id, lpwwn, &lport); status != HXA_STATUS_OK)
        return status;
    if (lport.pid == 0)
        return HXA_STATUS_PORT_OFFLINE;

    const fchs_t header = frame_header_from(lport.pid);
    const Request request = query_for(rport_pid);
    Response response{};
    uint32_t received = sizeof response;
    if (const hxa_status_t status = hxal_fcpt(ioc, 0, lpwwn, rpwwn, timeout, HXA_FALSE, FC_CLASS_3, &header, &request,
                                              sizeof request, &response, &received);
        status != HXA_STATUS_OK)
        return status;
    if (received == 0)
        return HXA_STATUS_OK;
    if (!is_accept(response))
        return HXA_STATUS_FABRIC_RJT;
    if (response.length == 0)
        return HXA_STATUS_OK;
    const std::size_t room = sizeof symname->symname - 1;
    hxal::fill_text(symname->symname, response.name, std::min<std::size_t>(response.length, room));
    return HXA_STATUS_OK;
}
