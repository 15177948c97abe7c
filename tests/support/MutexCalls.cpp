#include "tests/support/MutexCalls.h"

#include "tests/support/Next.h"

namespace
{
MutexCalls* inUse = nullptr;
}

MutexCalls::MutexCalls()
{
    inUse = this;
}

MutexCalls::~MutexCalls()
{
    inUse = nullptr;
}

namespace NQ
{

int Mutex::lock(unsigned long timeout)
{
    static auto* const real = next<int(Mutex*, unsigned long)>("_ZN2NQ5Mutex4lockEm");
    if (inUse && inUse->onLock)
        inUse->onLock(*this, timeout);
    return real(this, timeout);
}

int Mutex::unlock()
{
    static auto* const real = next<int(Mutex*)>("_ZN2NQ5Mutex6unlockEv");
    int const answer = inUse && inUse->onUnlock ? inUse->onUnlock(*this) : 0;
    int const result = real(this);
    return answer != 0 ? answer : result;
}

} // namespace NQ
