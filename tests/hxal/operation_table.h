// Operations that are one request each, as one table with a row for an operation. A row says what goes out, what comes back to
// the caller and what is recorded; the checks are the same for all.
#pragma once

#include "hxal/hxal.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <tuple>
#include <vector>

// The group byte on an FC or FCoE IOC, and on an Ethernet IOC; 0: refused there with HXA_STATUS_FAILED, before any request.
struct Groups
{
    std::uint8_t fc;
    std::uint8_t ll;
};

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

using Lines = std::vector<std::string>;

// The caller's side of an operation: a buffer that is big and aligned enough for every output.
using Call = std::function<hxa_status_t(hxal_t* ioc, void* output)>;

// The call of an operation with these arguments behind the handle.
template <typename Handle, typename... Parameters>
Call call(hxa_status_t (*operation)(Handle, Parameters...), std::type_identity_t<Parameters>... arguments)
{
    return [=](hxal_t* ioc, void*) { return operation(ioc, arguments...); };
}

// The same, and the buffer as the last argument.
template <typename Handle, typename... Parameters, typename... Arguments>
Call read(hxa_status_t (*operation)(Handle, Parameters...), Arguments... arguments)
{
    using Output = std::tuple_element_t<sizeof...(Parameters) - 1, std::tuple<Parameters...>>;
    return [=](hxal_t* ioc, void* output) { return operation(ioc, arguments..., static_cast<Output>(output)); };
}

struct Operation
{
    Groups groups;
    std::uint8_t number; // in the group
    std::size_t size;    // of the record
    Call call;
    std::vector<Sent> sent = {};
    std::vector<Copied> copied = {};     // none: the operation takes no buffer
    Lines fc_recorded = {};              // what status 0 adds to the configuration, for instance 1 of "/dev/hxa"
    Lines ll_recorded = {};              // the same for instance 1 of "/dev/hxn"
    const char* printed_on_error = "";   // on standard output when the call fails with EINTR
    const char* printed_on_refusal = ""; // on standard output when an Ethernet IOC is refused
    bool is_in_place = false;            // the record is the caller's buffer, also when the call fails
    bool output_is_optional = false;     // the caller may give no buffer

    // clang-format off
    Operation sends(std::vector<Sent> parts)         { sent = std::move(parts); return *this; }
    Operation copies(std::vector<Copied> parts)      { copied = std::move(parts); return *this; }
    Operation may_copy(std::vector<Copied> parts)    { output_is_optional = true; return copies(std::move(parts)); }
    Operation records(Lines fc, Lines ll = {})       { fc_recorded = std::move(fc); ll_recorded = std::move(ll); return *this; }
    Operation prints_on_error(const char* text)      { printed_on_error = text; return *this; }
    Operation prints_on_refusal(const char* text)    { printed_on_refusal = text; return *this; }
    Operation in_place()                             { is_in_place = true; return *this; }
    // clang-format on
};

const std::vector<Operation>& operations();

// Bytes as a record holds them.
template <typename Value> std::vector<std::uint8_t> bytes_of(const Value& value)
{
    const auto* first = reinterpret_cast<const std::uint8_t*>(&value);
    return {first, first + sizeof value};
}
std::vector<std::uint8_t> bytes_of(const char* text);
