// A block of counters as a driver keeps it.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>

namespace hxasim
{

// `Block` is the block in its record, a row of `Number`s.
template <typename Block, typename Number> class Counters
{
public:
    static constexpr std::size_t size = sizeof(Block) / sizeof(Number);

    // The first counters, in the order of the record; the others stay.
    void assign(std::span<const std::uint64_t> first)
    {
        auto* bytes = reinterpret_cast<unsigned char*>(&_block);
        for (std::size_t i = 0; i < first.size() && i < size; ++i)
        {
            auto value = static_cast<Number>(first[i]);
            std::memcpy(bytes + i * sizeof(Number), &value, sizeof(value));
        }
    }

    void reset()
    {
        _block = {};
        _since = Clock::now();
    }

    // The counters now. A block that begins with the seconds since its reset has them counted on.
    Block read() const
    {
        auto block = _block;
        if constexpr (requires { block.secs_reset; })
            block.secs_reset +=
                static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::seconds>(Clock::now() - _since).count());
        return block;
    }

    Block* operator->() { return &_block; }

private:
    using Clock = std::chrono::steady_clock;

    Block _block{};
    Clock::time_point _since = Clock::now();
};

} // namespace hxasim
