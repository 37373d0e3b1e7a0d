// Any bytes given as a text of a client, a driver or a device: what people see of it steers nothing, and what was so already
// stays as it is.
#include "text/safe_text.h"

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const std::string safe = text::safe_text(bytes);
    if (text::holds_steering(safe) || text::safe_text(safe) != safe || safe.size() > size)
        std::abort();
    if (text::safe_text(bytes, "\t").size() != safe.size())
        std::abort();
    return 0;
}
