#include "runtime/datetime.h"

#include <new>
#include <sys/time.h>
#include <utility>

namespace zmlr
{

namespace
{

void release(Datetime_Rep* rep)
{
    if (rep && Atomic_dec_and_test(&rep->refs))
        delete rep;
}

Datetime_Rep* acquire(Datetime_Rep* rep)
{
    if (rep)
        Atomic_inc(&rep->refs);
    return rep;
}

} // namespace

Datetime::Datetime() noexcept : _rep(nullptr) {}
Datetime::Datetime(uint64 usec, sint32 offset) : _rep(new Datetime_Rep{{1}, usec, offset, 1}) {}
Datetime::Datetime(uint64 usec) : _rep(new Datetime_Rep{{1}, usec, 0, 0}) {}

Datetime::Datetime(const char* text) : Datetime(0, 0) { set(text); }

Datetime::Datetime(const Datetime& x) noexcept : _rep(acquire(x._rep)) {}

Datetime& Datetime::operator=(const Datetime& x) noexcept
{
    release(std::exchange(_rep, acquire(x._rep)));
    return *this;
}

Datetime::~Datetime() { release(_rep); }

bool Datetime::is_interval() const { return !is_timestamp(); }
bool Datetime::is_timestamp() const { return _rep && _rep->is_timestamp; }
uint64 Datetime::usec() const { return _rep ? _rep->usec : 0; }
sint32 Datetime::offset() const { return _rep ? _rep->offset : 0; }

void Datetime::usec(uint64 usec)
{
    own();
    _rep->usec = usec;
}

void Datetime::offset(sint32 offset)
{
    own();
    _rep->offset = offset;
}

void Datetime::clear() { release(std::exchange(_rep, nullptr)); }
void Datetime::set(uint64 usec, sint32 offset) { *this = Datetime(usec, offset); }
void Datetime::set(uint64 usec) { *this = Datetime(usec); }

void Datetime::own()
{
    if (_rep && Atomic_get(&_rep->refs) == 1)
        return;
    release(std::exchange(_rep, new Datetime_Rep{{1}, usec(), offset(), is_timestamp() ? 1U : 0U}));
}

Datetime Datetime::now()
{
    timeval time{};
    struct timezone zone
    {
    };
    if (gettimeofday(&time, &zone) != 0)
        return {};
    return {static_cast<uint64>(time.tv_sec) * SEC + static_cast<uint64>(time.tv_usec), -zone.tz_minuteswest};
}

bool operator==(const Datetime& a, const Datetime& b)
{
    return a.usec() == b.usec() && a.offset() == b.offset() && a.is_timestamp() == b.is_timestamp();
}

} // namespace zmlr
