#include "mihost/accel/TextFile.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <linux/magic.h>
#include <linux/openat2.h>
#include <sys/syscall.h>
#include <sys/vfs.h>
#include <unistd.h>

namespace miaccel
{

namespace
{

// Not in the kernel's header of magic numbers.
constexpr unsigned long xfsMagic = 0x58465342;

/** Local ones, which give every change its time. ext2, ext3 and ext4 share a number. */
constexpr unsigned long goodFileSystems[] = {
    EXT4_SUPER_MAGIC,      xfsMagic,    BTRFS_SUPER_MAGIC, F2FS_SUPER_MAGIC,
    OVERLAYFS_SUPER_MAGIC, TMPFS_MAGIC,
};

/**
 * Never waits, as opening a pipe would. Links below /proc are refused: they lead a child of this
 * process somewhere else.
 */
int openPlainly(std::string const& path)
{
    open_how how{};
    how.flags = O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY;
    how.resolve = RESOLVE_NO_MAGICLINKS;
    return static_cast<int>(syscall(SYS_openat2, AT_FDCWD, path.c_str(), &how, sizeof how));
}

bool keepsTimes(int descriptor)
{
    struct statfs system {
    };
    if (fstatfs(descriptor, &system) != 0)
        return false;
    auto const type = static_cast<unsigned long>(system.f_type);
    return std::find(std::begin(goodFileSystems), std::end(goodFileSystems), type) !=
           std::end(goodFileSystems);
}

Reason judge(int descriptor)
{
    if (descriptor < 0)
        return "the file cannot be read";
    std::optional<FileStamp> const stamp = FileStamp::of(descriptor);
    if (!stamp || !stamp->isRegular())
        return "the file is no regular file";
    if (!keepsTimes(descriptor))
        return "the file system is not known to keep change times";
    return nullptr;
}

} // namespace

TextFile::TextFile(std::string const& path)
    : descriptor_(openPlainly(path)), declined_(judge(descriptor_))
{
}

TextFile::~TextFile()
{
    if (descriptor_ >= 0)
        close(descriptor_);
}

Reason TextFile::declined() const
{
    return declined_;
}

std::optional<FileStamp> TextFile::stamp() const
{
    return FileStamp::of(descriptor_);
}

bool TextFile::read(char* buffer, std::size_t length, std::uint64_t offset) const
{
    while (length > 0) {
        ssize_t const got = pread(descriptor_, buffer, length, static_cast<off_t>(offset));
        if (got < 0 && errno == EINTR)
            continue;
        if (got <= 0)
            return false;
        buffer += got;
        length -= static_cast<std::size_t>(got);
        offset += static_cast<std::uint64_t>(got);
    }
    return true;
}

} // namespace miaccel
