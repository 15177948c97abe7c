#include "tests/unit/AccelStandIns.h"

#include "tests/support/Next.h"

#include <unistd.h>

namespace accelStandIns
{

Hooks& hooks()
{
    static Hooks inUse;
    return inUse;
}

int realClockGettime(clockid_t clock, timespec* now)
{
    static auto* const real = next<int(clockid_t, timespec*)>("clock_gettime");
    return real(clock, now);
}

ssize_t realPread(int descriptor, void* buffer, std::size_t size, off_t offset)
{
    static auto* const real = next<ssize_t(int, void*, std::size_t, off_t)>("pread");
    return real(descriptor, buffer, size, offset);
}

int realFstatfs(int descriptor, struct statfs* system)
{
    static auto* const real = next<int(int, struct statfs*)>("fstatfs");
    return real(descriptor, system);
}

Guard::~Guard()
{
    hooks() = {};
}

ReadCounter::ReadCounter()
{
    hooks().pread = [this](int descriptor, void* buffer, std::size_t size, off_t offset) {
        ssize_t const got = realPread(descriptor, buffer, size, offset);
        bytes_ += static_cast<std::size_t>(got > 0 ? got : 0);
        return got;
    };
}

std::size_t ReadCounter::bytes() const
{
    return bytes_;
}

void ReadCounter::reset()
{
    bytes_ = 0;
}

} // namespace accelStandIns

using accelStandIns::hooks;

extern "C" {

int clock_gettime(clockid_t clock, timespec* now) noexcept
{
    return hooks().clock_gettime ? hooks().clock_gettime(clock, now)
                                 : accelStandIns::realClockGettime(clock, now);
}

ssize_t pread(int descriptor, void* buffer, std::size_t size, off_t offset)
{
    return hooks().pread ? hooks().pread(descriptor, buffer, size, offset)
                         : accelStandIns::realPread(descriptor, buffer, size, offset);
}

int fstatfs(int descriptor, struct statfs* system) noexcept
{
    return hooks().fstatfs ? hooks().fstatfs(descriptor, system)
                           : accelStandIns::realFstatfs(descriptor, system);
}

uid_t geteuid() noexcept
{
    static auto* const real = next<uid_t()>("geteuid");
    return hooks().geteuid ? hooks().geteuid() : real();
}

} // extern "C"
