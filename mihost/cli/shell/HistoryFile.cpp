#include "mihost/cli/shell/HistoryFile.h"

#include "mihost/cli/system/TextFile.h"

#include <algorithm>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace mihost
{

namespace
{

namespace fs = std::filesystem;

constexpr std::size_t longestLine = 4096; // bytes; typed lines are shorter
constexpr off_t mostRead = 1 << 20;       // bytes at the end of the file

bool isOwn(struct stat const& status)
{
    return status.st_uid == geteuid();
}

/** Opens a directory that belongs to the user; creates it if it is missing. */
Descriptor ownDirectory(fs::path const& path)
{
    std::error_code problem;
    fs::path existing = path;
    while (existing.has_relative_path() && !fs::exists(existing, problem))
        existing = existing.parent_path();
    struct stat status {
    };
    if (stat(existing.c_str(), &status) != 0 || !isOwn(status))
        return Descriptor();
    mode_t const usual = umask(S_IRWXG | S_IRWXO);
    fs::create_directories(path, problem);
    umask(usual);
    Descriptor directory(open(path.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    bool const isSafe = directory && fstat(directory.get(), &status) == 0 && isOwn(status) &&
                        (status.st_mode & (S_IWGRP | S_IWOTH)) == 0;
    return isSafe ? std::move(directory) : Descriptor();
}

/** @return the end of a file, at most mostRead bytes */
std::string endOf(int file)
{
    off_t const size = lseek(file, 0, SEEK_END);
    off_t const start = std::max<off_t>(size - mostRead, 0);
    std::string text(static_cast<std::size_t>(std::max<off_t>(size - start, 0)), '\0');
    ssize_t const length = pread(file, text.data(), text.size(), start);
    text.resize(static_cast<std::size_t>(std::max<ssize_t>(length, 0)));
    return start == 0 ? text : text.substr(std::min(text.find('\n'), text.size() - 1) + 1);
}

bool writeAll(int file, std::string const& text)
{
    return write(file, text.data(), text.size()) == static_cast<ssize_t>(text.size());
}

} // namespace

std::string historyPath()
{
    constexpr char file[] = "mihost/history";
    // A relative path means nothing here.
    if (char const* const state = std::getenv("XDG_STATE_HOME"); state && *state == '/')
        return fs::path(state) / file;
    if (char const* const home = std::getenv("HOME"); home && *home == '/')
        return fs::path(home) / ".local/state" / file;
    return "";
}

HistoryFile::HistoryFile(std::string const& path) : name_(fs::path(path).filename())
{
    if (!path.empty())
        directory_ = ownDirectory(fs::path(path).parent_path());
}

Descriptor HistoryFile::open(std::string const& name, int flags) const
{
    if (!directory_)
        return Descriptor();
    constexpr mode_t ownersOnly = S_IRUSR | S_IWUSR;
    Descriptor file(openat(directory_.get(), name.c_str(),
                           flags | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC, ownersOnly));
    struct stat status {
    };
    bool const isSafe = file && fstat(file.get(), &status) == 0 && S_ISREG(status.st_mode) &&
                        isOwn(status) && fchmod(file.get(), ownersOnly) == 0;
    return isSafe ? std::move(file) : Descriptor();
}

std::vector<std::string> HistoryFile::lines() const
{
    Descriptor const file = open(name_, O_RDONLY);
    if (!file)
        return {};
    std::vector<std::string> lines = linesOf(endOf(file.get()));
    if (lines.size() > historyLimit) {
        lines.erase(lines.begin(), lines.end() - historyLimit);
        replace(lines);
    }
    return lines;
}

void HistoryFile::add(std::string const& line) const
{
    if (line.size() > longestLine)
        return;
    if (Descriptor const file = open(name_, O_WRONLY | O_APPEND | O_CREAT))
        writeAll(file.get(), line + '\n');
}

/** Either writes all lines or leaves the file unchanged. */
void HistoryFile::replace(std::vector<std::string> const& lines) const
{
    std::string const other = name_ + '.' + std::to_string(getpid());
    std::string text;
    for (std::string const& line : lines)
        text += line + '\n';
    Descriptor const file = open(other, O_WRONLY | O_CREAT | O_EXCL);
    if (!file)
        return;
    if (!writeAll(file.get(), text) ||
        renameat(directory_.get(), other.c_str(), directory_.get(), name_.c_str()) != 0)
        unlinkat(directory_.get(), other.c_str(), 0);
}

} // namespace mihost
