// Boot code archives and option ROMs, made by hand.
#pragma once

#include <cstdint>
#include <cstdio>
#include <fstream>
#include <string>
#include <vector>

using Bytes = std::vector<uint8_t>;

inline Bytes bytes_of(const std::string& text) { return {text.begin(), text.end()}; }

// A tar file in the "ustar" format.
struct Archive
{
    std::string bytes;

    // Adds a member; `size` is what its header says, the truth by default.
    Archive& add(const std::string& name, const Bytes& data, const std::string& size = {})
    {
        std::string header(512, '\0');
        header.replace(0, name.size(), name);
        char octal[12];
        std::snprintf(octal, sizeof octal, "%011zo", data.size());
        header.replace(124, 11, size.empty() ? octal : size);
        header.replace(257, 5, "ustar");
        bytes += header;
        bytes.append(data.begin(), data.end());
        bytes.append((512 - data.size() % 512) % 512, '\0');
        return *this;
    }

    void save(const std::string& path) const { std::ofstream(path, std::ios::binary) << bytes; }
};

// The archive as the only member of another one.
inline Archive wrapped(const Archive& inner) { return Archive().add("boot_code.tar", bytes_of(inner.bytes)); }

// One image of an option ROM.
struct Rom
{
    uint8_t code_type = 0;
    bool last = true;
    uint16_t units = 2; // of 512 bytes
    uint16_t data_structure = 64;
    uint16_t pnp_header = 128;
    uint8_t pnp_units = 2; // of 16 bytes
    uint16_t device_id = 0x13;

    Bytes build() const
    {
        Bytes rom(1024, 0x5A);
        const auto put_word = [&](size_t at, uint16_t word)
        {
            rom[at] = static_cast<uint8_t>(word);
            rom[at + 1] = static_cast<uint8_t>(word >> 8);
        };
        put_word(0, 0xAA55);
        put_word(24, data_structure);
        put_word(26, pnp_header);
        put_word(64 + 6, device_id);
        put_word(64 + 16, units);
        rom[64 + 20] = code_type;
        rom[64 + 21] = last ? 0x80 : 0;
        rom[128 + 5] = pnp_units;
        put_word(128 + 12, device_id);
        return rom;
    }
};

inline Bytes joined(Bytes first, const Bytes& second)
{
    first.insert(first.end(), second.begin(), second.end());
    return first;
}
