#ifndef TESTS_SUPPORT_MUTEXCALLS_H
#define TESTS_SUPPORT_MUTEXCALLS_H

#include "host/Mutex.h"

#include <functional>

/**
 * Looks on while mutexes are locked and unlocked, for as long as it lives.
 *
 * The calls themselves go on to the host's mutex.
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

    /** Called before a mutex is unlocked. @return what the unlocking is to return */
    std::function<int(NQ::Mutex const& mutex)> onUnlock;
};

#endif
