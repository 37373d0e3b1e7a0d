// What the units of a simulated target answer to commands (SAM-3, SPC-3, SBC-2).
#pragma once

#include "sim/model/scsi_target.h"

#include "hxal/records/scsi.h"

namespace hxasim
{

struct Scsi_Answer
{
    std::uint8_t status = 0; // SAM-3
    std::vector<std::uint8_t> data = {};
    std::vector<std::uint8_t> sense = {};
};

// Carries out a command on the unit with this LUN (8 bytes in memory order).
Scsi_Answer execute(const Scsi_Target& target, lun_t lun, const scsi_cdb_t& cdb);

} // namespace hxasim
