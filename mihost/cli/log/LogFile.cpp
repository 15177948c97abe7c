#include "mihost/cli/log/LogFile.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace mihost
{

namespace
{

constexpr std::size_t blockSize = 1 << 14;
constexpr std::size_t longestKept = 1 << 16; // bytes of a line; more are never shown

Descriptor openLog(std::string const& path)
{
    return Descriptor(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
}

/** Where the newest lines that have ended begin. */
long long startOfNewest(int file, std::size_t count)
{
    std::array<char, blockSize> block{};
    for (long long end = lseek(file, 0, SEEK_END); end > 0;) {
        long long const start = std::max(end - static_cast<long long>(block.size()), 0LL);
        ssize_t at = pread(file, block.data(), static_cast<std::size_t>(end - start), start);
        while (--at >= 0)
            if (block[static_cast<std::size_t>(at)] == '\n' && count-- == 0)
                return start + at + 1;
        end = start;
    }
    return 0;
}

bool isSameFile(struct stat const& one, struct stat const& other)
{
    return one.st_dev == other.st_dev && one.st_ino == other.st_ino;
}

} // namespace

LogFile::LogFile(std::string const& path) : path_(path), file_(openLog(path))
{
    if (!file_)
        throw std::system_error(errno, std::generic_category(), path);
}

std::vector<std::string> LogFile::newestLines(std::size_t count)
{
    position_ = startOfNewest(file_.get(), count);
    unfinished_.clear();
    std::vector<std::string> lines;
    readTo(lines);
    return lines;
}

std::vector<std::string> LogFile::newLines()
{
    struct stat status {
    };
    if (fstat(file_.get(), &status) == 0 && status.st_size < position_) {
        position_ = 0;
        unfinished_.clear();
    }
    std::vector<std::string> lines;
    readTo(lines);
    if (takeNewFile())
        readTo(lines);
    return lines;
}

void LogFile::readTo(std::vector<std::string>& lines)
{
    std::array<char, blockSize> block{};
    ssize_t length = 0;
    while ((length = pread(file_.get(), block.data(), block.size(), position_)) > 0) {
        position_ += length;
        for (ssize_t at = 0; at < length; ++at) {
            char const byte = block[static_cast<std::size_t>(at)];
            if (byte == '\n')
                lines.push_back(std::exchange(unfinished_, ""));
            else if (unfinished_.size() < longestKept)
                unfinished_ += byte;
        }
    }
}

/** The old file has been read to its end; the writer may have kept it open until then. */
bool LogFile::takeNewFile()
{
    struct stat now {
    };
    struct stat before {
    };
    bool const isReplaced = stat(path_.c_str(), &now) == 0 && now.st_size > 0 &&
                            fstat(file_.get(), &before) == 0 && !isSameFile(now, before);
    Descriptor next = isReplaced ? openLog(path_) : Descriptor();
    if (!next)
        return false;
    file_ = std::move(next);
    position_ = 0;
    unfinished_.clear();
    return true;
}

} // namespace mihost
