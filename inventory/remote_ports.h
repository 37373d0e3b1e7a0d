// The remote ports of one FC port.
#pragma once

#include "hxal/hxal.h"
#include "runtime/log.h"

#include <array>
#include <cstdint>
#include <span>

namespace zmlr
{

constexpr std::uint16_t base_fabric = 0; // virtual fabric of the port itself

// Their port WWNs, in the driver's order.
class Remote_Ports
{
public:
    // Asks the driver (one request). Without an answer there are none, which is logged as an error for `log_source`; how many
    // there are is logged at `level`.
    Remote_Ports(const hxal_t* ioc, wwn_t port_wwn, const char* log_source, Log_Level level);

    std::span<const wwn_t> wwns() const { return {_wwns.data(), _count}; }

private:
    static constexpr std::uint32_t _room = 255;

    std::array<wwn_t, _room> _wwns{};
    std::uint32_t _count = 0;
};

} // namespace zmlr
