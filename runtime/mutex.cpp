#include "runtime/mutex.h"

#include "runtime/assert.h"

namespace zmlr
{

namespace
{

MutexRep* alive(void* rep)
{
    auto* mutex_rep = static_cast<MutexRep*>(rep);
    check(static_cast<bool>(mutex_rep->magic), "((MutexRep*)_rep)->magic");
    return mutex_rep;
}

void init(pthread_mutex_t* mutex, bool recursive)
{
    pthread_mutexattr_t attributes;
    pthread_mutexattr_init(&attributes);
    pthread_mutexattr_settype(&attributes, recursive ? PTHREAD_MUTEX_RECURSIVE : PTHREAD_MUTEX_ERRORCHECK);
    check(pthread_mutex_init(mutex, &attributes) == 0, "pthread_mutex_init(&((MutexRep*)_rep)->mutex, &attr) == 0");
    pthread_mutexattr_destroy(&attributes);
}

} // namespace

Mutex::Mutex(bool recursive)
{
    auto* rep = new MutexRep;
    init(&rep->mutex, recursive);
    _rep = rep;
}

Mutex::~Mutex()
{
    MutexRep* rep = alive(_rep);
    pthread_mutex_destroy(&rep->mutex);
    delete rep;
}

void Mutex::lock() { check(pthread_mutex_lock(&alive(_rep)->mutex) == 0, "pthread_mutex_lock(&((MutexRep*)_rep)->mutex) == 0"); }

int Mutex::try_lock() { return pthread_mutex_trylock(&alive(_rep)->mutex) == 0 ? 0 : -1; }

void Mutex::unlock()
{
    check(pthread_mutex_unlock(&alive(_rep)->mutex) == 0, "pthread_mutex_unlock(&((MutexRep*)_rep)->mutex) == 0");
}

} // namespace zmlr
