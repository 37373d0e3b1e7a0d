// Operations that are one request each, as tables: one table for an object family, one row for an operation. A row says what
// goes out, what comes back to the caller and what is recorded; the checks are the same for all.
#pragma once

#include "hxal/hxal.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

// Bytes of a record that the operation sends besides the instance; all others go out as 0.
struct Sent
{
    std::size_t offset;
    std::vector<std::uint8_t> bytes;
};

// A part of the driver's answer that is copied to the caller, and where in his buffer it goes.
struct Copied
{
    std::size_t offset; // in the record
    std::size_t size;
    std::size_t at = 0; // in the buffer
};

// The caller's side of an operation: a buffer that is big and aligned enough for every output.
using Call = std::function<hxa_status_t(hxal_t* ioc, void* output)>;

struct Operation
{
    const char* name;
    std::uint8_t fc_group; // group byte on an FC or FCoE IOC
    std::uint8_t ll_group; // group byte on an Ethernet IOC; 0: refused there with HXA_STATUS_FAILED, before any request
    std::uint8_t number;   // in the group
    std::size_t size;      // of the record
    Call call;
    std::vector<Sent> sent = {};
    std::vector<Copied> copied = {};           // none: the operation takes no buffer
    std::vector<std::string> fc_recorded = {}; // lines that status 0 adds to the configuration, for instance 1 of "/dev/hxa"
    std::vector<std::string> ll_recorded = {}; // the same for instance 1 of "/dev/hxn"
    const char* printed_on_error = "";         // on standard output when the call fails with ENXIO
    const char* printed_on_refusal = "";       // on standard output when an Ethernet IOC is refused
    bool in_place = false;                     // the record is the caller's buffer, also when the call fails
    bool optional_output = false;              // the caller may give no buffer
};

// The tables.
const std::vector<Operation>& flash_operations();
const std::vector<Operation>& ioc_operations();
const std::vector<Operation>& port_operations(); // port_operations.cpp
const std::vector<Operation>& fcoe_operations();
const std::vector<Operation>& ethport_operations();
const std::vector<Operation>& lport_operations(); // fabric_operations.cpp
const std::vector<Operation>& rport_operations();
const std::vector<Operation>& itnim_operations();
const std::vector<Operation>& fcpt_operations();
const std::vector<Operation>& scsi_operations();
const std::vector<Operation>& diag_operations(); // diag_operations.cpp

// Bytes as a record holds them.
template <typename Value> std::vector<std::uint8_t> bytes_of(const Value& value)
{
    const auto* first = reinterpret_cast<const std::uint8_t*>(&value);
    return {first, first + sizeof value};
}
std::vector<std::uint8_t> bytes_of(const char* text);
