#include "sim/commands/request_check.h"

#include <algorithm>
#include <cerrno>
#include <cstring>

namespace hxasim
{

namespace
{

constexpr std::uint32_t size_bits = 0x3FFF'0000;

std::uint32_t code_on(Node node, const hxal::Command& command)
{
    return hxal::command_code(command, node == Node::hxa ? command.family.fc : command.family.ll);
}

template <typename Predicate> const hxal::Command* first_command(Predicate matches)
{
    auto found = std::find_if(hxal::catalogue.begin(), hxal::catalogue.end(), matches);
    return found == hxal::catalogue.end() ? nullptr : &*found;
}

} // namespace

// The whole code is tried first: on one node two commands may differ by their record size alone.
Identified identify(Node node, std::uint32_t code)
{
    if (auto* exact = first_command([&](const auto& command) { return code_on(node, command) == code; }))
        return {.command = exact};
    auto other = node == Node::hxa ? Node::hxn : Node::hxa;
    if (auto* elsewhere = first_command([&](const auto& command) { return code_on(other, command) == code; }))
        return {.command = elsewhere, .error = ENOTTY, .why = std::string("belongs on ") + path_of(other)};
    auto but_for_size = [&](const auto& command) { return ((code_on(node, command) ^ code) & ~size_bits) == 0; };
    if (auto* resized = first_command(but_for_size))
        return {.command = resized,
                .error = EINVAL,
                .why = "record of " + std::to_string(record_size(code)) + " bytes, must be " + std::to_string(resized->size)};
    return {.error = ENOTTY, .why = "unknown command"};
}

std::string find_dirt(const Row& row, std::span<const std::uint8_t> record)
{
    std::vector<std::uint8_t> rest(record.begin(), record.end());
    row.clear_inputs(rest);
    const auto dirt = std::find_if(rest.begin(), rest.end(), [](std::uint8_t byte) { return byte != 0; });
    if (dirt == rest.end())
        return {};
    return "byte " + std::to_string(dirt - rest.begin()) + " is " + std::to_string(*dirt) + ", must be 0";
}

int instance_of(const Row& row, std::span<const std::uint8_t> record)
{
    if (row.target == Target::driver)
        return -1;
    std::uint32_t instance = 0; // of 2 or 4 bytes, the lowest first
    std::memcpy(&instance, &record[row.instance.offset], row.instance.size);
    return static_cast<int>(instance);
}

} // namespace hxasim
