// The two device nodes, and the drivers behind them.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

namespace hxasim
{

enum class Node : std::uint8_t
{
    hxa,
    hxn
};
constexpr std::array<const char*, 2> node_paths = {"/dev/hxa", "/dev/hxn"};
constexpr const char* path_of(Node node) { return node_paths[static_cast<std::size_t>(node)]; }
constexpr std::optional<Node> node_at(std::string_view path)
{
    for (auto node : {Node::hxa, Node::hxn})
        if (path == path_of(node))
            return node;
    return std::nullopt;
}

// A driver tells its application about this many IOCs at most.
constexpr int max_instances = 128;

struct Driver
{
    bool present = true;
    std::uint32_t version = 0x1020;
    std::uint32_t version_status = 0;
    std::optional<std::uint32_t> instance_count; // unset: the highest instance plus one
};

} // namespace hxasim
