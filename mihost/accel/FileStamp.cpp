#include "mihost/accel/FileStamp.h"

#include <ctime>

namespace miaccel
{

namespace
{

std::int64_t nanoseconds(timespec const& time)
{
    return std::int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
}

/** The clock that file systems take their times from. */
std::int64_t fileClock()
{
    timespec now{};
    clock_gettime(CLOCK_REALTIME_COARSE, &now);
    return nanoseconds(now);
}

std::int64_t fileClockTick()
{
    static std::int64_t const length = [] {
        timespec tick{};
        clock_getres(CLOCK_REALTIME_COARSE, &tick);
        return nanoseconds(tick);
    }();
    return length;
}

/** Taken when the library is loaded, so with the program's own start. */
std::int64_t const processStart = fileClock();

} // namespace

FileStamp::FileStamp(struct stat const& state, std::int64_t before)
    : device_(state.st_dev), inode_(state.st_ino), mode_(state.st_mode),
      size_(static_cast<std::uint64_t>(state.st_size)), changed_(nanoseconds(state.st_ctim)),
      settled_(changed_ + 2 * fileClockTick() < before)
{
}

std::optional<FileStamp> FileStamp::of(char const* path)
{
    std::int64_t const before = fileClock();
    struct stat state {
    };
    if (stat(path, &state) != 0)
        return std::nullopt;
    return FileStamp(state, before);
}

std::optional<FileStamp> FileStamp::of(int descriptor)
{
    std::int64_t const before = fileClock();
    struct stat state {
    };
    if (fstat(descriptor, &state) != 0)
        return std::nullopt;
    return FileStamp(state, before);
}

std::uint64_t FileStamp::size() const
{
    return size_;
}

bool FileStamp::isRegular() const
{
    return S_ISREG(mode_);
}

bool FileStamp::isSameFile(FileStamp const& other) const
{
    return device_ == other.device_ && inode_ == other.inode_;
}

bool FileStamp::isUnchangedSince(FileStamp const& earlier) const
{
    return earlier.settled_ && isSameFile(earlier) && size_ == earlier.size_ &&
           changed_ == earlier.changed_;
}

bool FileStamp::isSameOrLonger(FileStamp const& earlier) const
{
    return isSameFile(earlier) &&
           (size_ > earlier.size_ || (size_ == earlier.size_ && changed_ == earlier.changed_));
}

bool FileStamp::isOlderThanProcess() const
{
    return changed_ < processStart;
}

} // namespace miaccel
