#ifndef TESTS_SUPPORT_MUTEXCALLS_H
#define TESTS_SUPPORT_MUTEXCALLS_H

#include "tests/interpose/Host.h"

#include <functional>

/**
 * Observes the locking and unlocking of mutexes while it exists.
 *
 * The calls themselves are passed on to the host's mutex.
 */
class MutexCalls
{
public:
    MutexCalls()
    {
        host::hooks().lock.watch([this](NQ::Mutex* mutex, unsigned long timeout) {
            if (onLock)
                onLock(*mutex, timeout);
        });
        host::hooks().unlock = [this](NQ::Mutex* mutex) {
            int const answer = onUnlock ? onUnlock(*mutex) : 0;
            int const result = host::hooks().unlock.real()(mutex);
            return answer != 0 ? answer : result;
        };
    }
    ~MutexCalls()
    {
        host::hooks().lock.reset();
        host::hooks().unlock.reset();
    }
    MutexCalls(MutexCalls const&) = delete;
    MutexCalls& operator=(MutexCalls const&) = delete;

    /** Called before a mutex is waited for. */
    std::function<void(NQ::Mutex const& mutex, unsigned long timeout)> onLock;

    /** Called before a mutex is unlocked. @return what unlock returns to its caller */
    std::function<int(NQ::Mutex const& mutex)> onUnlock;
};

#endif
