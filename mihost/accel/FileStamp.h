#ifndef MIHOST_ACCEL_FILESTAMP_H
#define MIHOST_ACCEL_FILESTAMP_H

#include <cstdint>
#include <optional>
#include <sys/stat.h>

namespace miaccel
{

/** A file at one moment: what tells later whether it is still the same. */
class FileStamp
{
public:
    /** Follows links. Nothing where there is no such file, with errno set. */
    static std::optional<FileStamp> of(char const* path);
    static std::optional<FileStamp> of(int descriptor);

    std::uint64_t size() const;
    bool isRegular() const;
    bool isSameFile(FileStamp const& other) const;

    /**
     * Whether nothing has happened to the file since the earlier stamp was taken. Change times move
     * in ticks, so a file that was changed in the very tick of the earlier stamp, or after it by
     * the clock, proves nothing: the answer is no.
     */
    bool isUnchangedSince(FileStamp const& earlier) const;

    /** Whether the file may have been read since the earlier stamp as it was then, or longer. */
    bool isSameOrLonger(FileStamp const& earlier) const;

    /** Whether what the process may have read from the file at any time is still in it. */
    bool isOlderThanProcess() const;

private:
    FileStamp(struct stat const& state, std::int64_t before);

    dev_t device_;
    ino_t inode_;
    mode_t mode_;
    std::uint64_t size_;
    std::int64_t changed_; // nanoseconds since 1970
    bool settled_;         // a later change would show in the change time
};

} // namespace miaccel

#endif
