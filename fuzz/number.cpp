// Any text given to the number readers: a refused one leaves the number alone, an accepted one is held to what it says by
// writing it again, and a narrow reader accepts exactly what the wide one does within its range.
#include "runtime/number.h"

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <limits>
#include <string>

namespace
{

using namespace zmlr;

constexpr uint64 unread = 0xA5;

void expect(bool condition)
{
    if (!condition)
        std::abort();
}

template <class T, class Wide> void check_narrow(const char* text, int (*read)(const char*, T&), int wide_result, Wide wide)
{
    auto x = static_cast<T>(unread);
    const bool fits = wide >= std::numeric_limits<T>::min() && wide <= std::numeric_limits<T>::max();
    expect(read(text, x) == (wide_result == 0 && fits ? 0 : -1));
    expect(x == (wide_result == 0 && fits ? static_cast<T>(wide) : static_cast<T>(unread)));
}

void check_unsigned(const char* text)
{
    uint64 x = unread;
    const int result = str_to_uint64(text, x);
    check_narrow(text, str_to_uint8, result, x);
    check_narrow(text, str_to_uint16, result, x);
    check_narrow(text, str_to_uint32, result, x);
    if (result != 0)
        return expect(x == unread);

    char buffer[number_text_size];
    uint32 size = 0;
    const std::string written(uint64_to_str(buffer, x, size), size);
    uint64 again = ~x;
    expect(str_to_uint64(written.c_str(), again) == 0 && again == x);
}

void check_signed(const char* text)
{
    auto x = static_cast<sint64>(unread);
    const int result = str_to_sint64(text, x);
    check_narrow(text, str_to_sint8, result, x);
    check_narrow(text, str_to_sint16, result, x);
    check_narrow(text, str_to_sint32, result, x);
    if (result != 0)
        return expect(x == static_cast<sint64>(unread));

    char buffer[number_text_size];
    uint32 size = 0;
    const std::string written(sint64_to_str(buffer, x, size), size);
    sint64 again = ~x;
    expect(str_to_sint64(written.c_str(), again) == 0 && again == x);
}

void check_real(const char* text)
{
    real64 x = 0.5;
    const int result = str_to_real64(text, x);
    real32 narrow = 0.5F;
    expect(str_to_real32(text, narrow) == result);
    expect(result == 0 ? !std::isnan(x) && narrow == static_cast<real32>(x) : x == 0.5 && narrow == 0.5F);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string text(reinterpret_cast<const char*>(data), size);
    check_unsigned(text.c_str());
    check_signed(text.c_str());
    check_real(text.c_str());
    boolean truth = true;
    if (str_to_boolean(text.c_str(), truth) != 0)
        expect(truth);
    return 0;
}
