// Any text given to a Datetime: it is refused and leaves the value alone, or it is a value that can be written.
#include "runtime/datetime.h"

#include <cstddef>
#include <cstdint>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    using zmlr::Datetime;
    const std::string text(reinterpret_cast<const char*>(data), size);
    const Datetime before(1, 60);
    Datetime value(before);
    if (!value.set(text.c_str()))
        return value == before ? 0 : -1;
    char written[Datetime::text_size];
    value.ascii(written, false);
    return 0;
}
