#include "sim/commands/name_server.h"

#include "sim/model/record_fields.h"

#include "hxal/records/fcpt.h"

#include <algorithm>

namespace hxasim
{

namespace
{

constexpr std::uint8_t directory_service = 0xFC;
constexpr std::uint8_t name_server = 0x02;
constexpr std::uint8_t get_symbolic_port_name[] = {0x01, 0x18};
constexpr std::size_t symbolic_name_size = 255;

// Reasons of a reject, and the explanation of the last.
constexpr std::uint8_t invalid_version = 0x02;
constexpr std::uint8_t invalid_size = 0x04;
constexpr std::uint8_t unable_to_perform = 0x09;
constexpr std::uint8_t not_supported = 0x0B;
constexpr std::uint8_t no_such_port_identifier = 0x01;

fc_ct_header_t header_of(std::uint8_t response_low)
{
    fc_ct_header_t header{};
    header.revision = 0x01;
    header.gs_type = directory_service;
    header.gs_subtype = name_server;
    header.command[0] = 0x80;
    header.command[1] = response_low;
    return header;
}

std::vector<std::uint8_t> bytes_of(const fc_ct_header_t& header)
{
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&header);
    return {bytes, bytes + sizeof(header)};
}

std::vector<std::uint8_t> reject(std::uint8_t reason, std::uint8_t explanation = 0)
{
    auto header = header_of(0x01);
    header.reason = reason;
    header.explanation = explanation;
    return bytes_of(header);
}

// A length, then the name in a field of 255 bytes.
std::vector<std::uint8_t> accept(const std::string& name)
{
    auto response = bytes_of(header_of(0x02));
    response.push_back(static_cast<std::uint8_t>(name.size()));
    response.insert(response.end(), name.begin(), name.end());
    response.resize(sizeof(fc_ct_header_t) + 1 + symbolic_name_size);
    return response;
}

} // namespace

std::vector<std::uint8_t> ask_name_server(const Logical_Port& asking, std::span<const std::uint8_t> request)
{
    fc_ct_header_t header{};
    if (request.size() < sizeof(header))
        return reject(invalid_size);
    std::memcpy(&header, request.data(), sizeof(header));
    if (header.revision != 0x01)
        return reject(invalid_version);
    if (header.gs_type != directory_service || header.gs_subtype != name_server ||
        !std::equal(std::begin(header.command), std::end(header.command), std::begin(get_symbolic_port_name)))
        return reject(not_supported);
    if (request.size() != sizeof(header) + 4)
        return reject(invalid_size);
    auto has_address = [&](const Remote_Port& remote)
    {
        const auto address = wire_address(remote.address);
        return std::equal(address.begin(), address.end(), &request[sizeof(header) + 1]) && remote.state == HXA_RPORT_ONLINE;
    };
    auto found = std::find_if(asking.remote_ports.begin(), asking.remote_ports.end(), has_address);
    return found == asking.remote_ports.end() ? reject(unable_to_perform, no_such_port_identifier) : accept(found->symbolic_name);
}

} // namespace hxasim
