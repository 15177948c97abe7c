#include "mihost/cli/change/ChangeLock.h"

#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/Stderr.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <fmt/format.h>
#include <sys/file.h>
#include <thread>

namespace mihost
{

namespace
{

using std::chrono::milliseconds;
using std::chrono::steady_clock;

constexpr milliseconds pollInterval{50};

Failure cannotLock(std::string const& file, int problem)
{
    bool const isDenied = problem == EACCES || problem == EPERM;
    return {Failed, fmt::format("cannot lock {}: {}{}", file, std::strerror(problem),
                                isDenied ? " (changes need root)" : "")};
}

/** @return whether the lock was taken; not if another process holds it */
bool tryLock(int descriptor, std::string const& file)
{
    for (;;) {
        if (flock(descriptor, LOCK_EX | LOCK_NB) == 0)
            return true;
        if (errno == EWOULDBLOCK)
            return false;
        if (errno != EINTR)
            throw cannotLock(file, errno);
    }
}

} // namespace

ChangeLock::ChangeLock(std::string const& file, Patience patience)
    : file_(open(file.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0600))
{
    if (!file_)
        throw cannotLock(file, errno);
    auto const start = steady_clock::now();
    auto const limit = start + patience.limit;
    bool isSaid = false;
    while (!tryLock(file_.get(), file)) {
        auto const now = steady_clock::now();
        if (now >= limit)
            throw Failure(
                Failed,
                fmt::format("waiting for the change lock: another mihost still holds it (try "
                            "again, or raise --lock-timeout; 'fuser {}' shows the "
                            "process)",
                            file));
        if (!isSaid && now - start >= patience.silent) {
            warn("waiting for another mihost to finish its change");
            isSaid = true;
        }
        std::this_thread::sleep_for(std::min<steady_clock::duration>(pollInterval, limit - now));
    }
}

} // namespace mihost
