// Writing the row of a command: an answer, which fills the record in place, and the members that the sender sets.
//
//     void answer_power(Call&, hxa_ioctl_ioc_power_t& record) { ... }
//     constexpr auto power = [](auto& record) { return std::tie(record.power); };
//
//     constexpr Row rows[] = {ioc_row<answer_power>("IOCMD_IOC_SET_POWER", power)};
//
// The compiler holds name and record against the catalogue.
#pragma once

#include "sim/commands/command.h"
#include "sim/model/record_fields.h"

#include <cstring>
#include <tuple>
#include <type_traits>

namespace hxasim
{

namespace row_parts
{

template <auto> struct Answer_Record;
template <typename Record, void (*function)(Call&, Record&)> struct Answer_Record<function>
{
    using type = Record;
};

constexpr const hxal::Command* catalogued(std::string_view name)
{
    for (const auto& command : hxal::catalogue)
        if (command.name == name)
            return &command;
    throw "no such command in the catalogue";
}

// The record of an event fetch is as long as the sender has room, whatever the command's number tells: only its head is
// sure to be there, and only as much comes back as there are events. What an IOC raised can be fetched after it has gone.
constexpr bool is_event_fetch(const hxal::Command& command) { return command.name == "IOCMD_AEN_GET"; }

template <typename Record> consteval std::optional<std::size_t> status_offset()
{
    if constexpr (requires(Record record) { record.status; })
        return offsetof(Record, status);
    else
        return std::nullopt;
}

template <typename Record> consteval std::optional<std::size_t> remote_port_offset()
{
    if constexpr (requires(Record record) { record.rpwwn; })
        return offsetof(Record, rpwwn);
    else if constexpr (requires(Record record) { record.dpwwn; })
        return offsetof(Record, dpwwn);
    else
        return std::nullopt;
}

template <typename Record, Target target> consteval Field instance_field()
{
    if constexpr (target == Target::ioc)
        return {.offset = offsetof(Record, hxad_num), .size = sizeof(Record::hxad_num)};
    else
        return {};
}

// Bytes as they came in; behind them the record is 0.
template <typename Record> Record record_of(std::span<const std::uint8_t> bytes)
{
    static_assert(std::is_trivially_copyable_v<Record> && sizeof(Record) <= max_record_size);
    Record record{};
    std::memcpy(&record, bytes.data(), bytes.size());
    return record;
}

template <typename Record, Target target, typename Inputs> void clear_inputs(std::span<std::uint8_t> bytes)
{
    auto record = record_of<Record>(bytes);
    auto clear = [](auto&... members) { (std::memset(&members, 0, sizeof(members)), ...); };
    std::apply(clear, Inputs{}(record));
    if constexpr (target == Target::ioc)
        clear(record.hxad_num);
    std::memcpy(bytes.data(), &record, bytes.size());
}

template <auto function> void answer_with(Call& call, std::vector<std::uint8_t>& bytes)
{
    auto record = record_of<typename Answer_Record<function>::type>(bytes);
    function(call, record);
    bytes.resize(call.answer_size.value_or(sizeof(record)));
    std::memcpy(bytes.data(), &record, bytes.size());
}

template <typename Record, typename Buffers> std::vector<Buffer> buffers_of(std::span<const std::uint8_t> bytes)
{
    return Buffers{}(record_of<Record>(bytes));
}

struct No_Buffers
{
};

using List_Buffers = std::vector<Buffer> (*)(std::span<const std::uint8_t>);

template <typename Record, typename Buffers> consteval List_Buffers choose_buffers()
{
    if constexpr (std::is_same_v<Buffers, No_Buffers>)
        return nullptr;
    else
        return buffers_of<Record, Buffers>;
}

template <auto function, Target target, typename Inputs, typename Buffers = No_Buffers> consteval Row row(std::string_view name)
{
    using Record = typename Answer_Record<function>::type;
    const auto* command = catalogued(name);
    if (command->record != &hxal::record_tag<Record>)
        throw "the catalogue has another record for this command";
    return {.command = command,
            .target = target,
            .record_size = sizeof(Record),
            .sent_size = is_event_fetch(*command) ? offsetof(hxal_ioctl_aen_t, aen_list) : sizeof(Record),
            .instance = instance_field<Record, target>(),
            .status = status_offset<Record>(),
            .remote_port = remote_port_offset<Record>(),
            .of_absent = is_event_fetch(*command),
            .is_scsi = std::is_same_v<Record, hxa_ioctl_scsi_t>,
            .clear_inputs = clear_inputs<Record, target, Inputs>,
            .buffers = choose_buffers<Record, Buffers>(),
            .answer = answer_with<function>};
}

} // namespace row_parts

// What the sender sets besides the instance, as a tuple of references; all other bytes come in as 0.
inline constexpr auto nothing = [](auto&) { return std::tuple<>(); };

// A request to the driver as a whole.
template <auto function, typename Inputs = decltype(nothing)> consteval Row driver_row(std::string_view name, Inputs = {})
{
    return row_parts::row<function, Target::driver, Inputs>(name);
}

// A request to one IOC. `Buffers` lists the sender's buffers that the answer fills, the one for data first.
template <auto function, typename Inputs = decltype(nothing), typename Buffers = row_parts::No_Buffers>
consteval Row ioc_row(std::string_view name, Inputs = {}, Buffers = {})
{
    return row_parts::row<function, Target::ioc, Inputs, Buffers>(name);
}

} // namespace hxasim
