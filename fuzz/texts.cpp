// Any bytes given as a text of a client, a driver or a device: what people see of it steers nothing, and what a property holds
// can stand in an XML document. What was so already stays as it is.
#include "inventory/property_text.h"
#include "text/characters.h"
#include "text/safe_text.h"

#include <cstdint>
#include <cstdlib>

namespace
{

bool is_xml(std::string_view text)
{
    while (!text.empty())
    {
        const std::size_t size = text::xml_character_size(text);
        if (size == 0)
            return false;
        text.remove_prefix(size);
    }
    return true;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const std::string safe = text::safe_text(bytes);
    if (text::holds_steering(safe) || text::safe_text(safe) != safe || safe.size() > size)
        std::abort();
    if (text::safe_text(bytes, "\t").size() != safe.size())
        std::abort();

    const zmlr::String property = zmlr::property_text(bytes.data(), size);
    if (!is_xml({property.c_str(), property.size()}) || zmlr::property_text(property.c_str(), property.size()) != property)
        std::abort();
    return 0;
}
