// FC pass-through: any frame to any port, and the headers of the frames that the library itself sends. In the headers all
// fields are in the order of the wire, most significant byte first.
#pragma once

#include "hxal/records/header.h"

// Frame header, FC-FS-2.
typedef struct
{
    uint8_t r_ctl;        //  0  routing control
    uint8_t d_id[3];      //  1  to this address
    uint8_t cs_ctl;       //  4
    uint8_t s_id[3];      //  5  from this address
    uint8_t type;         //  8  of the payload
    uint8_t f_ctl[3];     //  9  frame control
    uint8_t seq_id;       // 12
    uint8_t df_ctl;       // 13
    uint8_t seq_cnt[2];   // 14
    uint8_t ox_id[2];     // 16  exchange, originator
    uint8_t rx_id[2];     // 18  exchange, responder
    uint8_t parameter[4]; // 20
} fchs_t;
static_assert(sizeof(fchs_t) == 24, "fchs_t");
static_assert(offsetof(fchs_t, s_id) == 5, "fchs_t");
static_assert(offsetof(fchs_t, type) == 8, "fchs_t");
static_assert(offsetof(fchs_t, rx_id) == 18, "fchs_t");
static_assert(offsetof(fchs_t, parameter) == 20, "fchs_t");

// Preamble of a request to a generic service of the fabric (common transport, FC-GS-6), and of the response.
typedef struct
{
    uint8_t revision;         //  0
    uint8_t in_id[3];         //  1
    uint8_t gs_type;          //  4
    uint8_t gs_subtype;       //  5
    uint8_t options;          //  6
    uint8_t rsvd;             //  7
    uint8_t command[2];       //  8  command, or the response to it
    uint8_t residual_size[2]; // 10  in words
    uint8_t fragment_id;      // 12
    uint8_t reason;           // 13  of a reject
    uint8_t explanation;      // 14  of a reject
    uint8_t vendor_unique;    // 15
} fc_ct_header_t;
static_assert(sizeof(fc_ct_header_t) == 16, "fc_ct_header_t");
static_assert(offsetof(fc_ct_header_t, gs_type) == 4, "fc_ct_header_t");
static_assert(offsetof(fc_ct_header_t, command) == 8, "fc_ct_header_t");
static_assert(offsetof(fc_ct_header_t, vendor_unique) == 15, "fc_ct_header_t");

// IOCMD_FCPT. Request and response lie in buffers of the sender.
typedef struct
{
    hxa_status_t status;        //  0
    uint16_t hxad_num;          //  4
    uint16_t vf_id;             //  6  virtual fabric
    wwn_t lpwwn;                //  8  of the logical port
    wwn_t dpwwn;                // 16  of the destination; 0: none
    uint32_t tsecs;             // 24  seconds until the driver gives up
    int32_t cts;                // 28  boolean, as the sender says
    uint32_t cos;               // 32  fc_cos_t
    uint32_t rsvd;              // 36
    fchs_t fchs;                // 40
    int32_t nport_nexus_needed; // 64  1 with a destination, else 0
    uint32_t reqsz;             // 68  request, bytes
    uint32_t rspsz;             // 72  in: room for the response, bytes; out: its length
    uint32_t rsvd1;             // 76
    uint64_t reqbuf_ptr;        // 80  addresses of the sender, zero-extended
    uint64_t rspbuf_ptr;        // 88
} hxa_ioctl_fcpt_t;
static_assert(sizeof(hxa_ioctl_fcpt_t) == 96, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, dpwwn) == 16, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, cos) == 32, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, fchs) == 40, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, nport_nexus_needed) == 64, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, rspsz) == 72, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, reqbuf_ptr) == 80, "hxa_ioctl_fcpt_t");
static_assert(offsetof(hxa_ioctl_fcpt_t, rspbuf_ptr) == 88, "hxa_ioctl_fcpt_t");
