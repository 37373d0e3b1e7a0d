// Any text given to a Datetime: a refused one leaves the value alone; an accepted interval is written as it was read unless a
// field carries over, and what a Datetime writes it reads back: as the same value in a zone without changes of the clock.
#include "runtime/datetime.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
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

    // Fields may carry over into a ninth digit of days, a fifth of the year or a year before 0: that text is cut.
    Datetime again;
    if (again.set(written) && !(again == value) && again.usec() != value.usec())
        std::abort();
    return 0;
}
