// Any text given to a Datetime: a refused one leaves the value alone; what an accepted one is written as is read back, and
// written as the same text (in a zone whose clock never changes).
#include "runtime/datetime.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <string>

extern "C" int LLVMFuzzerInitialize(int*, char***)
{
    setenv("TZ", "UTC", 1);
    tzset();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    using zmlr::Datetime;
    const std::string text(reinterpret_cast<const char*>(data), size);
    const Datetime before(1, 60);
    Datetime value(before);
    if (!value.set(text.c_str()))
    {
        if (!(value == before))
            std::abort();
        return 0;
    }

    char written[Datetime::text_size];
    value.ascii(written, false);
    char pretty[Datetime::pretty_text_size];
    value.ascii(pretty, true);

    // The value itself may be one that no text can tell: the nearest one stands for it.
    Datetime again;
    char rewritten[Datetime::text_size];
    if (!again.set(written))
        std::abort();
    again.ascii(rewritten, false);
    if (std::strcmp(written, rewritten) != 0)
        std::abort();
    return 0;
}
