#ifndef UTIL_MUTEXLOCK_H
#define UTIL_MUTEXLOCK_H

#include "host/Mutex.h"
#include "util/internal.h"

namespace NQ
{

/** Holds a mutex, waited for without limit, until it is released or the object is destroyed. */
class MI_INTERNAL MutexLock
{
public:
    explicit MutexLock(Mutex& mutex);
    ~MutexLock();
    MutexLock(MutexLock const&) = delete;
    MutexLock& operator=(MutexLock const&) = delete;

    /** Unlocks now; to be called once at most. @return what unlocking returned */
    int release();

private:
    Mutex* mutex_; // null once released
};

} // namespace NQ

#endif
