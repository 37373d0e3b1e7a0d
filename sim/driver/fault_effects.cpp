#include "sim/driver/fault_effects.h"

#include "sim/commands/caller_memory.h"

#include <algorithm>
#include <cstring>
#include <random>

namespace hxasim
{

namespace
{

using Random = std::mt19937;

std::uint8_t random_byte(Random& random) { return static_cast<std::uint8_t>(random()); }

// A success keeps the status that it would have had.
void fill_record(const Fault& fault, const Row& row, Random& random, std::vector<std::uint8_t>& answered)
{
    const auto before = answered;
    std::generate(answered.begin(), answered.end(), [&] { return random_byte(random); });
    if (fault.error == 0 && row.status)
        std::copy_n(&before[*row.status], sizeof(std::uint32_t), &answered[*row.status]);
}

// In pieces: a sender may claim to have more memory than there is.
void fill_buffer(const Buffer& buffer, Random& random)
{
    std::array<std::uint8_t, 4096> piece{};
    for (std::uint64_t done = 0; done < buffer.size; done += piece.size())
    {
        std::generate(piece.begin(), piece.end(), [&] { return random_byte(random); });
        const auto size = static_cast<std::size_t>(std::min<std::uint64_t>(piece.size(), buffer.size - done));
        if (!copy_to_caller(address_of(buffer.pointer + done), std::span(piece).first(size)))
            return;
    }
}

void overwrite(const std::vector<Patch>& patches, std::span<std::uint8_t> record)
{
    for (const auto& patch : patches)
    {
        auto place = record.subspan(std::min(patch.offset, record.size()));
        std::copy_n(patch.bytes.begin(), std::min(patch.bytes.size(), place.size()), place.begin());
    }
}

void overwrite(const std::vector<Patch>& patches, const Buffer& buffer)
{
    for (const auto& patch : patches)
    {
        const auto offset = std::min<std::uint64_t>(patch.offset, buffer.size);
        const auto size = static_cast<std::size_t>(std::min<std::uint64_t>(patch.bytes.size(), buffer.size - offset));
        copy_to_caller(address_of(buffer.pointer + offset), std::span(patch.bytes).first(size));
    }
}

template <typename Value> void put(std::vector<std::uint8_t>& record, std::size_t offset, Value value)
{
    std::memcpy(&record[offset], &value, sizeof(value));
}

} // namespace

bool is_carried_out(const Fault& fault) { return fault.error == 0 && fault.status == 0 && !fault.scsi_status; }

void spoil(const Fault& fault, const Row& row, std::span<const std::uint8_t> sent, std::vector<std::uint8_t>& answered)
{
    const auto buffers = row.buffers ? row.buffers(sent) : std::vector<Buffer>();
    if (fault.scsi_status)
        put(answered, offsetof(hxa_ioctl_scsi_t, snssz), std::uint32_t{0});
    if (fault.garbage)
    {
        Random random(*fault.garbage);
        fill_record(fault, row, random, answered);
        for (const auto& buffer : buffers)
            fill_buffer(buffer, random);
    }
    if (fault.status != 0)
        put(answered, *row.status, fault.status);
    if (fault.scsi_status)
        put(answered, offsetof(hxa_ioctl_scsi_t, scsi_status), *fault.scsi_status);
    overwrite(fault.answer, answered);
    if (!buffers.empty())
        overwrite(fault.data, buffers.front());
}

} // namespace hxasim
