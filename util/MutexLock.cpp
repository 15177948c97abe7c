#include "util/MutexLock.h"

namespace NQ
{

namespace
{
constexpr unsigned long waitForever = 0xFFFFFFFFUL;
}

MutexLock::MutexLock(Mutex& mutex) : mutex_(&mutex)
{
    mutex.lock(waitForever);
}

MutexLock::~MutexLock()
{
    if (mutex_)
        mutex_->unlock();
}

int MutexLock::release()
{
    Mutex& mutex = *mutex_;
    mutex_ = nullptr;
    return mutex.unlock();
}

} // namespace NQ
