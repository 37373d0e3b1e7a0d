#include "cli/words.h"

#include "cli/failure.h"
#include "cli/field_text.h"
#include "text/integers.h"

#include <string_view>

namespace hxa
{

namespace
{

[[noreturn]] void refuse(const std::string& text, const std::string& what)
{
    throw Failure(Exit::usage, "\"" + safe_text(text) + "\" is no " + what);
}

} // namespace

bool read_switch(const std::string& text)
{
    if (text != "on" && text != "off")
        refuse(text, "switch: on or off");
    return text == "on";
}

hxa_pport_speed_t read_speed(const std::string& text)
{
    if (text == "auto")
        return HXA_PPORT_SPEED_AUTO;
    for (const auto speed :
         {HXA_PPORT_SPEED_1GBPS, HXA_PPORT_SPEED_2GBPS, HXA_PPORT_SPEED_4GBPS, HXA_PPORT_SPEED_8GBPS, HXA_PPORT_SPEED_10GBPS})
        if (text == std::to_string(speed))
            return speed;
    refuse(text, "speed: auto, or 1, 2, 4, 8 or 10 Gbit/s");
}

hxa_pport_topology_t read_topology(const std::string& text)
{
    if (text == "p2p")
        return HXA_PPORT_TOPOLOGY_P2P;
    if (text == "loop")
        return HXA_PPORT_TOPOLOGY_LOOP;
    if (text == "auto")
        return HXA_PPORT_TOPOLOGY_AUTO;
    refuse(text, "topology: p2p, loop or auto");
}

void check_name(const std::string& text, std::size_t most)
{
    if (text.size() > most || safe_text(text) != text || text.find('"') != std::string::npos)
        refuse(text, "name: up to " + std::to_string(most) + " bytes of printable text without a quotation mark");
}

std::uint32_t read_number(const std::string& text, std::uint32_t most, int base, const std::string& what)
{
    std::string_view digits = text;
    if (base == 16 && (digits.starts_with("0x") || digits.starts_with("0X")))
        digits.remove_prefix(2);
    const auto number = text::read_digits(digits, base);
    if (!number || *number > most)
        refuse(text, what + ": a " +
                         (base == 16 ? "hexadecimal number up to " + hexadecimal(most, most > 0xFF ? 8 : 2)
                                     : "number up to " + std::to_string(most)));
    return static_cast<std::uint32_t>(*number);
}

std::uint32_t read_bits(const std::string& text, std::uint32_t most, const std::string& what)
{
    std::uint32_t bits = 0;
    for (std::size_t begin = 0; begin <= text.size();)
    {
        const auto end = std::min(text.find(',', begin), text.size());
        bits |= std::uint32_t{1} << read_number(text.substr(begin, end - begin), most, 10, what);
        begin = end + 1;
    }
    return bits;
}

} // namespace hxa
