#ifndef TESTS_UNIT_ACCELSTANDINS_H
#define TESTS_UNIT_ACCELSTANDINS_H

#include <cstddef>
#include <ctime>
#include <functional>
#include <sys/types.h>
#include <sys/vfs.h>

/**
 * The libc calls that the accelerator makes, replaced in the test program. Those not set fall
 * through to the real ones.
 */
namespace accelStandIns
{

struct Hooks {
    std::function<int(clockid_t clock, timespec* now)> clock_gettime;
    std::function<ssize_t(int descriptor, void* buffer, std::size_t size, off_t offset)> pread;
    std::function<int(int descriptor, struct statfs* system)> fstatfs;
    std::function<uid_t()> geteuid;
};

Hooks& hooks();

int realClockGettime(clockid_t clock, timespec* now);
ssize_t realPread(int descriptor, void* buffer, std::size_t size, off_t offset);
int realFstatfs(int descriptor, struct statfs* system);

/** Takes all hooks away when it goes. */
class Guard
{
public:
    Guard() = default;
    ~Guard();
    Guard(Guard const&) = delete;
    Guard& operator=(Guard const&) = delete;
};

/** Counts the bytes that pread gives from now on. */
class ReadCounter
{
public:
    ReadCounter();

    std::size_t bytes() const;
    void reset();

private:
    Guard guard_;
    std::size_t bytes_ = 0;
};

} // namespace accelStandIns

#endif
