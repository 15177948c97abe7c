#include "tests/support/MutexCalls.h"

#include "tests/interpose/Host.h"

MutexCalls::MutexCalls()
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

MutexCalls::~MutexCalls()
{
    host::hooks().lock.reset();
    host::hooks().unlock.reset();
}
