// What a fault makes of an answer.
#pragma once

#include "sim/commands/command.h"
#include "sim/model/fault.h"

#include <span>
#include <vector>

namespace hxasim
{

// Whether the request is carried out at all.
bool is_carried_out(const Fault& fault);

// Turns the answer into what the fault says, and the sender's buffers that the record refers to as well, as far as they can be
// written. `sent` is the record as it came in.
void spoil(const Fault& fault, const Row& row, std::span<const std::uint8_t> sent, std::vector<std::uint8_t>& answered);

} // namespace hxasim
