// The nets for allocation, freeing and locking: they stand in front of the C library's functions, also for what the
// process loads later.
#include "tests/support/RealtimeGuardInternal.h"

#if ZEB_GUARD_INTERPOSES

#include <cerrno>
#include <cstddef>
#include <dlfcn.h>
#include <pthread.h>
#include <semaphore.h>
#include <threads.h>

// The allocator behind the public names.
extern "C" void* __libc_malloc(std::size_t size);
extern "C" void* __libc_calloc(std::size_t count, std::size_t size);
extern "C" void* __libc_realloc(void* block, std::size_t size);
extern "C" void* __libc_memalign(std::size_t alignment, std::size_t size);
extern "C" void __libc_free(void* block);

#define ZEB_INTERPOSE extern "C" __attribute__((visibility("default")))

namespace
{

using realtimeguard::Record;
using realtimeguard::Violation;

// The C library's own function of a name. Looked up once, before any section: the first call of each comes early, and
// racing look-ups find the same.
template <typename Function>
Function* Original(Function*& cache, const char* name)
{
    Function* original = __atomic_load_n(&cache, __ATOMIC_RELAXED);
    if (original == nullptr)
    {
        original = reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
        __atomic_store_n(&cache, original, __ATOMIC_RELAXED);
    }
    return original;
}

} // namespace

ZEB_INTERPOSE void* malloc(std::size_t size) noexcept
{
    Record(Violation::Allocation);
    return __libc_malloc(size);
}

ZEB_INTERPOSE void* calloc(std::size_t count, std::size_t size) noexcept
{
    Record(Violation::Allocation);
    return __libc_calloc(count, size);
}

ZEB_INTERPOSE void* realloc(void* block, std::size_t size) noexcept
{
    Record(Violation::Allocation);
    return __libc_realloc(block, size);
}

ZEB_INTERPOSE void* reallocarray(void* block, std::size_t count, std::size_t size) noexcept
{
    std::size_t bytes = 0;
    if (!__builtin_mul_overflow(count, size, &bytes))
        return realloc(block, bytes);
    errno = ENOMEM;
    return nullptr;
}

ZEB_INTERPOSE void* memalign(std::size_t alignment, std::size_t size) noexcept
{
    Record(Violation::Allocation);
    return __libc_memalign(alignment, size);
}

ZEB_INTERPOSE void* aligned_alloc(std::size_t alignment, std::size_t size) noexcept
{
    return memalign(alignment, size);
}

ZEB_INTERPOSE int posix_memalign(void** block, std::size_t alignment, std::size_t size) noexcept
{
    void* const made = memalign(alignment, size);
    if (made == nullptr)
        return ENOMEM;
    *block = made;
    return 0;
}

ZEB_INTERPOSE void free(void* block) noexcept
{
    if (block != nullptr)
        Record(Violation::Free);
    __libc_free(block);
}

// One lock function of the C library: counted, then carried out.
#define ZEB_INTERPOSE_LOCK(name, parameters, arguments, exceptions)                                                  \
    ZEB_INTERPOSE int name parameters exceptions                                                                     \
    {                                                                                                                \
        static int(*sOriginal) parameters = nullptr;                                                                 \
        Record(Violation::Lock);                                                                                     \
        return Original(sOriginal, #name) arguments;                                                                 \
    }

ZEB_INTERPOSE_LOCK(pthread_mutex_lock, (pthread_mutex_t * mutex), (mutex), noexcept)
ZEB_INTERPOSE_LOCK(pthread_mutex_trylock, (pthread_mutex_t * mutex), (mutex), noexcept)
ZEB_INTERPOSE_LOCK(pthread_mutex_timedlock, (pthread_mutex_t * mutex, const timespec* until), (mutex, until),
                   noexcept)
ZEB_INTERPOSE_LOCK(pthread_mutex_clocklock, (pthread_mutex_t * mutex, clockid_t clock, const timespec* until),
                   (mutex, clock, until), noexcept)
ZEB_INTERPOSE_LOCK(mtx_lock, (mtx_t * mutex), (mutex), )
ZEB_INTERPOSE_LOCK(mtx_trylock, (mtx_t * mutex), (mutex), )
ZEB_INTERPOSE_LOCK(pthread_rwlock_rdlock, (pthread_rwlock_t * lock), (lock), noexcept)
ZEB_INTERPOSE_LOCK(pthread_rwlock_tryrdlock, (pthread_rwlock_t * lock), (lock), noexcept)
ZEB_INTERPOSE_LOCK(pthread_rwlock_wrlock, (pthread_rwlock_t * lock), (lock), noexcept)
ZEB_INTERPOSE_LOCK(pthread_rwlock_trywrlock, (pthread_rwlock_t * lock), (lock), noexcept)
ZEB_INTERPOSE_LOCK(pthread_spin_lock, (pthread_spinlock_t * lock), (lock), noexcept)
ZEB_INTERPOSE_LOCK(pthread_cond_signal, (pthread_cond_t * condition), (condition), noexcept)
ZEB_INTERPOSE_LOCK(pthread_cond_broadcast, (pthread_cond_t * condition), (condition), noexcept)
ZEB_INTERPOSE_LOCK(pthread_cond_wait, (pthread_cond_t * condition, pthread_mutex_t* mutex), (condition, mutex), )
ZEB_INTERPOSE_LOCK(pthread_cond_timedwait,
                   (pthread_cond_t * condition, pthread_mutex_t* mutex, const timespec* until),
                   (condition, mutex, until), )
ZEB_INTERPOSE_LOCK(pthread_cond_clockwait,
                   (pthread_cond_t * condition, pthread_mutex_t* mutex, clockid_t clock, const timespec* until),
                   (condition, mutex, clock, until), )
ZEB_INTERPOSE_LOCK(sem_wait, (sem_t * semaphore), (semaphore), )
ZEB_INTERPOSE_LOCK(sem_trywait, (sem_t * semaphore), (semaphore), noexcept)
ZEB_INTERPOSE_LOCK(sem_timedwait, (sem_t * semaphore, const timespec* until), (semaphore, until), )
ZEB_INTERPOSE_LOCK(sem_post, (sem_t * semaphore), (semaphore), noexcept)

#endif
