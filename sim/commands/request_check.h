// Is this a request that the driver behind the node would accept? Nothing here has a side effect.
#pragma once

#include "sim/commands/command.h"

namespace hxasim
{

struct Identified
{
    const hxal::Command* command = nullptr; // also when only its size or node is wrong
    int error = 0;                          // ENOTTY: not a command of this node; EINVAL: another record size
    std::string why = {};
};

// What a 32-bit request code means on a node.
Identified identify(Node node, std::uint32_t code);

// The record size that a request code announces.
constexpr std::size_t record_size(std::uint32_t code) { return code >> 16 & 0x3FFF; }

// What is wrong with the record's bytes; empty when nothing is.
std::string find_dirt(const Row& row, std::span<const std::uint8_t> record);

// The instance that the record names; -1 when it is for the driver as a whole.
int instance_of(const Row& row, std::span<const std::uint8_t> record);

} // namespace hxasim
