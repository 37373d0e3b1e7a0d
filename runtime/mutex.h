// Mutex: a POSIX mutex, recursive on demand, that knows whether it is still alive. Auto_Mutex holds one for a scope.
#pragma once

#include "runtime/magic.h"

#include <pthread.h>

namespace zmlr
{

struct MutexRep
{
    pthread_mutex_t mutex;
    Magic<0x482A8C83> magic;
};

// A lock or unlock that fails is an internal-consistency failure: one by a thread that does not hold it, a second lock of a
// mutex that is not recursive by the thread that does. So is the use of a mutex after its end.
class Mutex
{
public:
    explicit Mutex(bool recursive = true);
    ~Mutex();
    Mutex(const Mutex&) = delete;
    Mutex& operator=(const Mutex&) = delete;

    void lock();
    int try_lock(); // 0 when obtained, -1 otherwise
    void unlock();

private:
    void* _rep;
};

class Auto_Mutex
{
public:
    explicit Auto_Mutex(Mutex& mutex) : _mutex(mutex) { _mutex.lock(); }
    ~Auto_Mutex() { _mutex.unlock(); }
    Auto_Mutex(const Auto_Mutex&) = delete;
    Auto_Mutex& operator=(const Auto_Mutex&) = delete;

private:
    Mutex& _mutex;
};

} // namespace zmlr
