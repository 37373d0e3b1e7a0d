// What copies share: one pointer to a constant, safe in several threads at once. The default value takes no room.
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

namespace cimserver
{

// A block that counts its owners; Block::end() frees it after the last of them.
template <class Block> class Counted
{
public:
    explicit Counted(Block* block = nullptr) : _block(block) {}
    Counted(const Counted& x) : _block(x._block)
    {
        if (_block)
            ++_block->owners;
    }
    Counted(Counted&& x) noexcept : _block(std::exchange(x._block, nullptr)) {}
    ~Counted()
    {
        if (_block && --_block->owners == 0)
            Block::end(_block);
    }
    Counted& operator=(Counted x) noexcept
    {
        std::swap(_block, x._block);
        return *this;
    }

    const Block* get() const { return _block; }

private:
    Block* _block;
};

template <class T> class Shared
{
public:
    Shared() = default;
    Shared(T value) : _block(new Block{std::move(value)}) {}

    explicit operator bool() const { return _block.get(); } // whether it was made of a value
    const T& operator*() const
    {
        if (const Block* block = _block.get())
            return block->value;
        static const T default_value{};
        return default_value;
    }

private:
    struct Block
    {
        static void end(Block* block) { delete block; }

        const T value;
        std::atomic<std::size_t> owners = 1;
    };

    Counted<Block> _block;
};

// Any bytes but zero.
class Text
{
public:
    Text() = default;
    Text(std::string_view text) : _block(text.empty() ? nullptr : make(text)) {}
    Text(const std::string& text) : Text(std::string_view(text)) {}
    Text(const char* text) : Text(std::string_view(text)) {}

    bool empty() const { return !_block.get(); }
    const char* c_str() const { return empty() ? "" : reinterpret_cast<const char*>(_block.get() + 1); }
    std::string_view view() const { return {c_str(), empty() ? 0 : _block.get()->size}; }
    operator std::string_view() const { return view(); }
    operator std::string() const { return string(); }
    std::string string() const { return std::string(view()); }
    friend bool operator==(const Text& a, std::string_view b) { return a.view() == b; }

private:
    struct Block // the bytes and a terminator follow
    {
        static void end(Block* block) { ::operator delete(block); }

        std::atomic<std::uint32_t> owners;
        std::uint32_t size;
    };

    static Block* make(std::string_view text); // names.cpp

    Counted<Block> _block;
};

} // namespace cimserver
