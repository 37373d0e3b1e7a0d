// The broker's extension table: threads, keys, mutexes and conditions, over POSIX. Those that return int answer an errno
// value; there is no search path for libraries, so file names are not resolved.
#include "cimserver/broker/broker.h"

#include <chrono>
#include <memory>
#include <new>
#include <pthread.h>
#include <thread>

namespace cimserver
{
namespace
{

static_assert(sizeof(pthread_t) == sizeof(CMPI_THREAD_TYPE));
static_assert(std::is_same_v<pthread_key_t, CMPI_THREAD_KEY_TYPE>);
static_assert(std::is_same_v<pthread_once_t, int>);

pthread_t native(CMPI_THREAD_TYPE thread) { return reinterpret_cast<pthread_t>(thread); }
pthread_mutex_t* native_mutex(CMPI_MUTEX_TYPE mutex) { return static_cast<pthread_mutex_t*>(mutex); }
pthread_cond_t* native_condition(CMPI_COND_TYPE condition) { return static_cast<pthread_cond_t*>(condition); }

char* resolve_file_name(const char*) noexcept { return nullptr; }

CMPI_THREAD_TYPE new_thread(CMPI_THREAD_RETURN (*start)(void*), void* parameter, int detached) noexcept
{
    pthread_t thread{};
    if (pthread_create(&thread, nullptr, start, parameter) != 0)
        return nullptr;
    if (detached != 0)
        pthread_detach(thread);
    return reinterpret_cast<CMPI_THREAD_TYPE>(thread);
}

int join_thread(CMPI_THREAD_TYPE thread, CMPI_THREAD_RETURN* result) noexcept { return pthread_join(native(thread), result); }

// Not noexcept: the thread's frames, this one included, are unwound.
int exit_thread(CMPI_THREAD_RETURN result) { pthread_exit(result); }

int cancel_thread(CMPI_THREAD_TYPE thread) noexcept { return pthread_cancel(native(thread)); }

int thread_sleep(CMPIUint32 msec) noexcept
{
    std::this_thread::sleep_for(std::chrono::milliseconds(msec));
    return 0;
}

int thread_once(int* once, void (*init)()) noexcept { return pthread_once(once, init); }

int create_thread_key(CMPI_THREAD_KEY_TYPE* key, void (*cleanup)(void*)) noexcept { return pthread_key_create(key, cleanup); }

int destroy_thread_key(CMPI_THREAD_KEY_TYPE key) noexcept { return pthread_key_delete(key); }

void* get_thread_specific(CMPI_THREAD_KEY_TYPE key) noexcept { return pthread_getspecific(key); }

int set_thread_specific(CMPI_THREAD_KEY_TYPE key, void* value) noexcept { return pthread_setspecific(key, value); }

CMPI_MUTEX_TYPE new_mutex(int) noexcept
{
    std::unique_ptr<pthread_mutex_t> mutex(new (std::nothrow) pthread_mutex_t);
    return mutex && pthread_mutex_init(mutex.get(), nullptr) == 0 ? mutex.release() : nullptr;
}

void destroy_mutex(CMPI_MUTEX_TYPE mutex) noexcept
{
    if (mutex && pthread_mutex_destroy(native_mutex(mutex)) == 0)
        delete native_mutex(mutex);
}

void lock_mutex(CMPI_MUTEX_TYPE mutex) noexcept { pthread_mutex_lock(native_mutex(mutex)); }

void unlock_mutex(CMPI_MUTEX_TYPE mutex) noexcept { pthread_mutex_unlock(native_mutex(mutex)); }

CMPI_COND_TYPE new_condition(int) noexcept
{
    std::unique_ptr<pthread_cond_t> condition(new (std::nothrow) pthread_cond_t);
    return condition && pthread_cond_init(condition.get(), nullptr) == 0 ? condition.release() : nullptr;
}

void destroy_condition(CMPI_COND_TYPE condition) noexcept
{
    if (condition && pthread_cond_destroy(native_condition(condition)) == 0)
        delete native_condition(condition);
}

int cond_wait(CMPI_COND_TYPE condition, CMPI_MUTEX_TYPE mutex) noexcept
{
    return pthread_cond_wait(native_condition(condition), native_mutex(mutex));
}

int timed_cond_wait(CMPI_COND_TYPE condition, CMPI_MUTEX_TYPE mutex, timespec* until) noexcept
{
    return pthread_cond_timedwait(native_condition(condition), native_mutex(mutex), until);
}

int signal_condition(CMPI_COND_TYPE condition) noexcept { return pthread_cond_signal(native_condition(condition)); }

} // namespace

const CMPIBrokerExtFT system_service_table = {
    .ftVersion = 100,
    .resolveFileName = resolve_file_name,
    .newThread = new_thread,
    .joinThread = join_thread,
    .exitThread = exit_thread,
    .cancelThread = cancel_thread,
    .threadSleep = thread_sleep,
    .threadOnce = thread_once,
    .createThreadKey = create_thread_key,
    .destroyThreadKey = destroy_thread_key,
    .getThreadSpecific = get_thread_specific,
    .setThreadSpecific = set_thread_specific,
    .newMutex = new_mutex,
    .destroyMutex = destroy_mutex,
    .lockMutex = lock_mutex,
    .unlockMutex = unlock_mutex,
    .newCondition = new_condition,
    .destroyCondition = destroy_condition,
    .condWait = cond_wait,
    .timedCondWait = timed_cond_wait,
    .signalCondition = signal_condition,
};

} // namespace cimserver
