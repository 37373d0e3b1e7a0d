// Datetime: a CIM timestamp or interval (one handle of pointer size), see DSP0004 "datetime".
#pragma once

#include "runtime/atomic.h"
#include "runtime/string.h"
#include "runtime/types.h"

#include <cstdio>

namespace zmlr
{

struct Datetime_Rep
{
    Atomic refs;
    uint64 usec;         // an interval's length, or microseconds since 1970-01-01
    sint32 offset;       // minutes from UTC (timestamps)
    uint32 is_timestamp; // 1 timestamp, 0 interval
};

// Copies share one representation; a change copies it first. An all-zero handle is an interval of zero. Timestamps are
// written and read in the machine's local time; the offset is stored and written as given. A time before 1970 is kept in
// two's complement. The fields of a text are not range checked: a 25th hour counts into the next day.
class Datetime
{
public:
    static constexpr uint64 USEC = 1;
    static constexpr uint64 MSEC = 1000;
    static constexpr uint64 SEC = 1000000;
    static constexpr uint64 MIN = 60 * SEC;
    static constexpr uint64 HOUR = 60 * MIN;
    static constexpr uint64 DAY = 24 * HOUR;

    static constexpr std::size_t text_size = 26;        // the 25-character form and a terminator
    static constexpr std::size_t pretty_text_size = 32; // the prettified form of either kind and a terminator

    Datetime() noexcept;                  // an interval of zero
    Datetime(uint64 usec, sint32 offset); // a timestamp
    explicit Datetime(uint64 usec);       // an interval
    explicit Datetime(const char* text);  // as set(text); a timestamp of zero when the text is invalid
    Datetime(const Datetime& x) noexcept;
    Datetime& operator=(const Datetime& x) noexcept;
    ~Datetime();

    bool is_interval() const;
    bool is_timestamp() const;
    uint64 usec() const;
    void usec(uint64 usec);
    sint32 offset() const;
    void offset(sint32 offset);
    void clear();
    void set(uint64 usec, sint32 offset);
    void set(uint64 usec);

    // Reads the 25-character form; false (and no change) when the text is not one.
    bool set(const char* text);

    // Writes the 25-character form to a buffer of text_size bytes, or the prettified form to one of pretty_text_size. What no
    // such text can tell (days of nine digits, a year of five) is written as the nearest that one can.
    void ascii(char* buffer, bool prettify = false) const;
    String ascii(bool prettify = false) const;
    void print(std::FILE* stream, bool prettify = false) const; // the text and a newline

    void set_interval(uint32 days, uint32 hours, uint32 minutes, uint32 seconds, uint32 microseconds);
    void get_interval(uint32& days, uint32& hours, uint32& minutes, uint32& seconds, uint32& microseconds) const;
    void set_timestamp(uint32 year, uint32 month, uint32 day, uint32 hour, uint32 minute, uint32 second, uint32 microseconds,
                       sint32 offset);
    void get_timestamp(uint32& year, uint32& month, uint32& day, uint32& hour, uint32& minute, uint32& second,
                       uint32& microseconds, sint32& offset) const;

    // The current time; an interval of zero when the system cannot tell.
    static Datetime now();

private:
    void own();
    Datetime_Rep* _rep;
};

bool operator==(const Datetime& a, const Datetime& b);

} // namespace zmlr
