#include "mihost/sandbox/LayerFiles.h"

#include "mihost/sandbox/Folder.h"
#include "mihost/sandbox/SystemCall.h"

#include <algorithm>
#include <array>
#include <fcntl.h>
#include <sys/sysmacros.h>
#include <sys/xattr.h>

namespace mihost::layerFiles
{

namespace
{

constexpr off_t longestText = 8'388'608;

/** In the form for calls relative to an open directory. */
std::string below(std::string const& path)
{
    return path.empty() ? "." : path.substr(1);
}

/** Does not wait for the other end of a pipe. */
Descriptor openBelow(Descriptor const& root, std::string const& path, int flags)
{
    return Descriptor(check(openat(root.get(), below(path).c_str(),
                                   O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC | flags),
                            "cannot read " + path));
}

/** Fills the block unless the file ends. @return the number of bytes */
std::size_t readBlock(Descriptor const& file, char* block, std::size_t size,
                      std::string const& path)
{
    std::size_t got = 0;
    while (got < size) {
        ssize_t const count = read(file.get(), block + got, size - got);
        if (count < 0 && errno == EINTR)
            continue;
        if (check(count, "cannot read " + path) == 0)
            break;
        got += static_cast<std::size_t>(count);
    }
    return got;
}

} // namespace

std::optional<struct stat> statusOf(Descriptor const& root, std::string const& path)
{
    struct stat status {
    };
    if (fstatat(root.get(), below(path).c_str(), &status, AT_SYMLINK_NOFOLLOW) == 0)
        return status;
    if (errno != ENOENT && errno != ENOTDIR)
        failed("cannot look at " + path);
    return std::nullopt;
}

std::string targetOf(Descriptor const& root, std::string const& path)
{
    std::string target(4096, '\0');
    target.resize(static_cast<std::size_t>(
        check(readlinkat(root.get(), below(path).c_str(), target.data(), target.size()),
              "cannot read the link " + path)));
    return target;
}

std::optional<std::string> textOf(Descriptor const& root, std::string const& path)
{
    Descriptor const file = openBelow(root, path, 0);
    struct stat status {
    };
    check(fstat(file.get(), &status), "cannot look at " + path);
    if (status.st_size > longestText)
        return std::nullopt;
    std::string text(static_cast<std::size_t>(status.st_size), '\0');
    text.resize(readBlock(file, text.data(), text.size(), path));
    if (text.find('\0') != std::string::npos)
        return std::nullopt;
    return text;
}

bool sameContent(Descriptor const& root, Descriptor const& otherRoot, std::string const& path)
{
    Descriptor const file = openBelow(root, path, 0);
    Descriptor const other = openBelow(otherRoot, path, 0);
    std::array<char, 65536> block{};
    std::array<char, 65536> otherBlock{};
    for (;;) {
        std::size_t const count = readBlock(file, block.data(), block.size(), path);
        if (readBlock(other, otherBlock.data(), otherBlock.size(), path) != count ||
            !std::equal(block.begin(), block.begin() + count, otherBlock.begin()))
            return false;
        if (count == 0)
            return true;
    }
}

bool isOpaque(Descriptor const& root, std::string const& path)
{
    Descriptor const directory = openBelow(root, path, O_DIRECTORY);
    char value = 0;
    return fgetxattr(directory.get(), "trusted.overlay.opaque", &value, 1) == 1 && value == 'y';
}

bool isWhiteout(struct stat const& status)
{
    return S_ISCHR(status.st_mode) && status.st_rdev == makedev(0, 0);
}

void walk(Descriptor const& root, std::string const& path, Visit const& visit)
{
    for (std::string const& name : namesIn(openBelow(root, path, O_DIRECTORY), path)) {
        std::string place = path;
        place.append("/").append(name);
        auto const status = statusOf(root, place);
        if (!status)
            continue; // something still running removed it
        visit(place, *status);
        if (S_ISDIR(status->st_mode))
            walk(root, place, visit);
    }
}

} // namespace mihost::layerFiles
