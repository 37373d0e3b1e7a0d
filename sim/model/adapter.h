// A card: what its drivers know of it before anybody asks.
#pragma once

#include "sim/model/flash.h"
#include "sim/model/port.h"

#include <cstdint>
#include <string>
#include <vector>

namespace hxasim
{

enum class Adapter_Kind : std::uint32_t
{
    fc_hba,
    cna,
    mezzanine
};

struct Vpd
{
    std::uint8_t version = 1;
    std::uint8_t vendor = 0;
    std::vector<std::uint8_t> data; // at most 512 bytes
};

struct Adapter
{
    Adapter_Kind kind = Adapter_Kind::fc_hba;
    std::string serial;
    std::string name;
    std::string model;
    std::string model_descr;
    std::string manufacturer;
    std::string hwpath;
    std::string hw_version;
    std::string firmware_version;
    std::string fc_driver_version;
    std::string eth_driver_version;
    std::string bios_version;
    std::string efi_version;
    std::string fcode_version;
    std::string os_type;
    std::uint16_t device_id = 0;
    std::uint8_t max_speed = 0;
    std::uint16_t temperature = 45;
    bool cna_capable = false;
    bool is_mezz = false;
    bool plugged = true; // in the host, that is; its drivers know it only then
    Vpd vpd;
    Flash flash;
    std::vector<Port> ports;

    bool converged() const { return kind != Adapter_Kind::fc_hba; }
};

} // namespace hxasim
