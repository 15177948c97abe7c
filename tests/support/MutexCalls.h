#ifndef TESTS_SUPPORT_MUTEXCALLS_H
#define TESTS_SUPPORT_MUTEXCALLS_H

#include "host/Mutex.h"

#include <functional>

/**
 * Observes the locking and unlocking of mutexes while it exists.
 *
 * The calls themselves are passed on to the host's mutex.
 */
class MutexCalls
{
public:
    MutexCalls();
    ~MutexCalls();
    MutexCalls(MutexCalls const&) = delete;
    MutexCalls& operator=(MutexCalls const&) = delete;

    /** Called before a mutex is waited for. */
    std::function<void(NQ::Mutex const& mutex, unsigned long timeout)> onLock;

    /** Called before a mutex is unlocked. @return what unlock returns to its caller */
    std::function<int(NQ::Mutex const& mutex)> onUnlock;
};

#endif
