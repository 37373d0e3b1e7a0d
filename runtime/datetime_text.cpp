#include "runtime/ascii.h"
#include "runtime/datetime.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <ctime>

namespace zmlr
{

namespace
{

constexpr std::size_t text_length = Datetime::text_size - 1;

struct Calendar_Time
{
    std::tm fields;
    uint32 microseconds;
};

// Before 1970 the count is negative in two's complement; microseconds always count upwards from a whole second.
Calendar_Time to_calendar(uint64 usec)
{
    constexpr auto second = static_cast<sint64>(Datetime::SEC);
    const auto count = static_cast<sint64>(usec);
    const sint64 remainder = count % second;
    const auto seconds = static_cast<std::time_t>(count / second - (remainder < 0));

    Calendar_Time time{};
    localtime_r(&seconds, &time.fields);
    time.microseconds = static_cast<uint32>(remainder < 0 ? remainder + second : remainder);
    return time;
}

// Reads fixed-width decimal fields one after the other; a non-digit makes the whole reading fail.
class Field_Reader
{
public:
    explicit Field_Reader(const char* text) : _next(text) {}

    uint32 number(int width)
    {
        uint32 value = 0;
        for (int i = 0; i < width; ++i, ++_next)
        {
            _good = _good && ascii::is_digit(*_next);
            value = value * 10 + static_cast<uint32>(*_next - '0');
        }
        return value;
    }

    void literal(char c)
    {
        _good = _good && *_next == c;
        ++_next;
    }
    void skip() { ++_next; }
    bool good() const { return _good; }

private:
    const char* _next;
    bool _good = true;
};

bool read_interval(const char* text, Datetime& out)
{
    Field_Reader reader(text);
    const uint32 days = reader.number(8);
    const uint32 hours = reader.number(2);
    const uint32 minutes = reader.number(2);
    const uint32 seconds = reader.number(2);
    reader.literal('.');
    const uint32 microseconds = reader.number(6);
    reader.skip();
    reader.literal('0');
    reader.literal('0');
    reader.literal('0');
    if (!reader.good())
        return false;
    out.set_interval(days, hours, minutes, seconds, microseconds);
    return true;
}

bool read_timestamp(const char* text, Datetime& out)
{
    Field_Reader reader(text);
    const uint32 year = reader.number(4);
    const uint32 month = reader.number(2);
    const uint32 day = reader.number(2);
    const uint32 hour = reader.number(2);
    const uint32 minute = reader.number(2);
    const uint32 second = reader.number(2);
    reader.literal('.');
    const uint32 microseconds = reader.number(6);
    reader.skip();
    const auto offset = static_cast<sint32>(reader.number(3));
    if (!reader.good())
        return false;
    out.set_timestamp(year, month, day, hour, minute, second, microseconds, text[21] == '-' ? -offset : offset);
    return true;
}

} // namespace

bool Datetime::set(const char* text)
{
    if (!text || strnlen(text, text_size) != text_length)
        return false;

    switch (text[21])
    {
    case ':':
        return read_interval(text, *this);
    case '+':
    case '-':
        return read_timestamp(text, *this);
    default:
        return false;
    }
}

namespace
{

// Writes fields of fixed width one after the other, each with its separator where the text is for people.
class Field_Writer
{
public:
    Field_Writer(char* buffer, bool prettify) : _next(buffer), _prettify(prettify) {}

    void number(uint32 value, int width)
    {
        for (int i = width; i-- > 0; value /= 10)
            _next[i] = static_cast<char>('0' + value % 10);
        _next += width;
    }
    void number_and(char separator, uint32 value, int width)
    {
        number(value, width);
        if (_prettify)
            character(separator);
    }
    void character(char c) { *_next++ = c; }

private:
    char* _next;
    bool _prettify;
};

// The nearest time that four digits of a year can tell.
Calendar_Time to_writable_calendar(uint64 usec)
{
    const Calendar_Time time = to_calendar(usec);
    const int year = time.fields.tm_year + 1900;
    if (year >= 0 && year <= 9999)
        return time;

    Calendar_Time nearest{};
    std::tm& fields = nearest.fields;
    fields.tm_year = -1900;
    fields.tm_mday = 1;
    if (year > 0)
    {
        fields.tm_year = 9999 - 1900;
        fields.tm_mon = 11;
        fields.tm_mday = 31;
        fields.tm_hour = 23;
        fields.tm_min = fields.tm_sec = 59;
        nearest.microseconds = 999'999;
    }
    return nearest;
}

void write_interval(Field_Writer& out, const Datetime& interval)
{
    constexpr uint64 longest = 100'000'000 * Datetime::DAY - 1; // in eight digits of days
    const uint64 length = std::min(interval.usec(), longest);
    const auto field = [](uint64 value) { return static_cast<uint32>(value); };
    out.number_and(' ', field(length / Datetime::DAY), 8);
    out.number_and(' ', field(length / Datetime::HOUR % 24), 2);
    out.number_and(' ', field(length / Datetime::MIN % 60), 2);
    out.number(field(length / Datetime::SEC % 60), 2);
    out.character('.');
    out.number(field(length % Datetime::SEC), 6);
    out.character(':');
    out.number(0, 3);
}

void write_timestamp(Field_Writer& out, const Datetime& timestamp)
{
    const Calendar_Time time = to_writable_calendar(timestamp.usec());
    const auto field = [](int value) { return static_cast<uint32>(value); };
    out.number_and('/', field(time.fields.tm_year + 1900), 4);
    out.number_and('/', field(time.fields.tm_mon + 1), 2);
    out.number_and(' ', field(time.fields.tm_mday), 2);
    out.number_and(':', field(time.fields.tm_hour), 2);
    out.number_and(':', field(time.fields.tm_min), 2);
    out.number(field(time.fields.tm_sec), 2);
    out.character('.');
    out.number(time.microseconds, 6);
    out.character(timestamp.offset() < 0 ? '-' : '+');
    out.number(field(std::abs(std::clamp(timestamp.offset(), -999, 999))), 3);
}

} // namespace

void Datetime::ascii(char* buffer, bool prettify) const
{
    Field_Writer out(buffer, prettify);
    is_interval() ? write_interval(out, *this) : write_timestamp(out, *this);
    out.character('\0');
}

String Datetime::ascii(bool prettify) const
{
    char buffer[pretty_text_size];
    ascii(buffer, prettify);
    return buffer;
}

void Datetime::print(std::FILE* stream, bool prettify) const
{
    char buffer[pretty_text_size];
    ascii(buffer, prettify);
    std::fprintf(stream, "%s\n", buffer);
}

void Datetime::set_interval(uint32 days, uint32 hours, uint32 minutes, uint32 seconds, uint32 microseconds)
{
    set(days * DAY + hours * HOUR + minutes * MIN + seconds * SEC + microseconds);
}

void Datetime::get_interval(uint32& days, uint32& hours, uint32& minutes, uint32& seconds, uint32& microseconds) const
{
    const uint64 length = usec();
    days = static_cast<uint32>(length / DAY);
    hours = static_cast<uint32>(length / HOUR % 24);
    minutes = static_cast<uint32>(length / MIN % 60);
    seconds = static_cast<uint32>(length / SEC % 60);
    microseconds = static_cast<uint32>(length % SEC);
}

void Datetime::set_timestamp(uint32 year, uint32 month, uint32 day, uint32 hour, uint32 minute, uint32 second,
                             uint32 microseconds, sint32 offset)
{
    std::tm fields{};
    fields.tm_year = static_cast<int>(year - 1900);
    fields.tm_mon = static_cast<int>(month - 1);
    fields.tm_mday = static_cast<int>(day);
    fields.tm_hour = static_cast<int>(hour);
    fields.tm_min = static_cast<int>(minute);
    fields.tm_sec = static_cast<int>(second);
    fields.tm_isdst = -1; // the platform decides
    set(static_cast<uint64>(std::mktime(&fields)) * SEC + microseconds, offset);
}

void Datetime::get_timestamp(uint32& year, uint32& month, uint32& day, uint32& hour, uint32& minute, uint32& second,
                             uint32& microseconds, sint32& offset_out) const
{
    const Calendar_Time time = to_calendar(usec());
    year = static_cast<uint32>(time.fields.tm_year + 1900);
    month = static_cast<uint32>(time.fields.tm_mon + 1);
    day = static_cast<uint32>(time.fields.tm_mday);
    hour = static_cast<uint32>(time.fields.tm_hour);
    minute = static_cast<uint32>(time.fields.tm_min);
    second = static_cast<uint32>(time.fields.tm_sec);
    microseconds = time.microseconds;
    offset_out = offset();
}

} // namespace zmlr
