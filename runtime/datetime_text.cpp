#include "runtime/datetime.h"
#include "text/datetime.h"

#include <algorithm>
#include <cstring>
#include <ctime>

namespace zmlr
{

namespace
{

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

} // namespace

bool Datetime::set(const char* text)
{
    const auto fields = text ? text::read_datetime({text, strnlen(text, text_size)}) : std::nullopt;
    if (!fields)
        return false;
    if (fields->interval)
        set_interval(fields->day, fields->hour, fields->minute, fields->second, fields->microsecond);
    else
        set_timestamp(fields->year, fields->month, fields->day, fields->hour, fields->minute, fields->second, fields->microsecond,
                      fields->offset);
    return true;
}

namespace
{

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

text::Datetime_Fields interval_fields(uint64 usec)
{
    constexpr uint64 longest = 100'000'000 * Datetime::DAY - 1; // in eight digits of days
    const uint64 length = std::min(usec, longest);
    const auto field = [](uint64 value) { return static_cast<uint32>(value); };
    text::Datetime_Fields fields;
    fields.interval = true;
    fields.day = field(length / Datetime::DAY);
    fields.hour = field(length / Datetime::HOUR % 24);
    fields.minute = field(length / Datetime::MIN % 60);
    fields.second = field(length / Datetime::SEC % 60);
    fields.microsecond = field(length % Datetime::SEC);
    return fields;
}

text::Datetime_Fields timestamp_fields(uint64 usec, sint32 offset)
{
    const Calendar_Time time = to_writable_calendar(usec);
    const auto field = [](int value) { return static_cast<uint32>(value); };
    text::Datetime_Fields fields;
    fields.year = field(time.fields.tm_year + 1900);
    fields.month = field(time.fields.tm_mon + 1);
    fields.day = field(time.fields.tm_mday);
    fields.hour = field(time.fields.tm_hour);
    fields.minute = field(time.fields.tm_min);
    fields.second = field(time.fields.tm_sec);
    fields.microsecond = time.microseconds;
    fields.offset = std::clamp(offset, -999, 999);
    return fields;
}

} // namespace

void Datetime::ascii(char* buffer, bool prettify) const
{
    const auto fields = is_interval() ? interval_fields(usec()) : timestamp_fields(usec(), offset());
    *text::write_datetime(fields, buffer, prettify) = '\0';
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
