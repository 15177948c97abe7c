#include "mihost/cli/plugin/TraceFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fmt/format.h>
#include <sys/stat.h>
#include <utility>

namespace mihost
{

namespace
{

// Not truncated yet: first the kind of file is checked.
constexpr int writing = O_WRONLY | O_CLOEXEC | O_NOCTTY;
constexpr mode_t ownersOnly = S_IRUSR | S_IWUSR;

Failure refusal(std::string const& path, std::string const& reason)
{
    return {BadUsage, fmt::format("cannot write the trace '{}': {}", path, reason)};
}

struct Opened {
    Descriptor file;
    bool byLink;
};

/** Another user's link in a directory such as /tmp could lead to any file of the caller's. */
void expectOwnLink(std::string const& path)
{
    struct stat link {
    };
    if (lstat(path.c_str(), &link) != 0)
        throw cannotWriteTrace(path, errno);
    if (link.st_uid != 0 && link.st_uid != geteuid())
        throw refusal(path, "the link belongs to another user (name another file)");
}

Descriptor create(std::string const& path)
{
    return Descriptor(open(path.c_str(), writing | O_CREAT | O_EXCL | O_NOFOLLOW, ownersOnly));
}

Opened openAny(std::string const& path)
{
    Descriptor file(open(path.c_str(), writing | O_NOFOLLOW));
    if (!file && errno == ENOENT)
        file = create(path);
    bool const byLink = !file && errno == ELOOP;
    if (byLink) {
        expectOwnLink(path);
        file = Descriptor(open(path.c_str(), writing | O_CREAT, ownersOnly));
    }
    if (!file)
        throw cannotWriteTrace(path, errno);
    return {std::move(file), byLink};
}

struct stat statusOf(int file, std::string const& path)
{
    struct stat status {
    };
    if (fstat(file, &status) != 0)
        throw cannotWriteTrace(path, errno);
    return status;
}

/** The standard stream that is this same file; negative for none. */
int streamThatIs(struct stat const& file)
{
    for (int const stream : {STDOUT_FILENO, STDERR_FILENO}) {
        struct stat status {
        };
        if (fstat(stream, &status) == 0 && status.st_dev == file.st_dev &&
            status.st_ino == file.st_ino)
            return stream;
    }
    return -1;
}

Descriptor replace(std::string const& path, bool byLink)
{
    std::error_code problem;
    std::string const place = byLink ? std::filesystem::canonical(path, problem).string() : path;
    if (problem)
        throw cannotWriteTrace(path, problem.value());
    if (unlink(place.c_str()) != 0)
        throw cannotWriteTrace(path, errno);
    Descriptor file = create(place);
    if (!file)
        throw cannotWriteTrace(path, errno);
    return file;
}

} // namespace

Failure cannotWriteTrace(std::string const& path, int problem)
{
    return refusal(path, std::strerror(problem));
}

Descriptor openTraceFile(std::string const& path)
{
    Opened opened = openAny(path);
    struct stat const status = statusOf(opened.file.get(), path);
    bool const isFile = S_ISREG(status.st_mode);
    if (int const stream = streamThatIs(status); isFile && stream >= 0)
        return Descriptor(fcntl(stream, F_DUPFD_CLOEXEC, 0));
    bool const isNamedPipe = S_ISFIFO(status.st_mode) && !opened.byLink;
    if ((isFile || isNamedPipe) && status.st_uid != geteuid())
        throw refusal(path, "it belongs to another user (name another file)");
    if (!isFile)
        return std::move(opened.file);
    if ((status.st_mode & (S_IRWXG | S_IRWXO)) != 0 || status.st_nlink > 1)
        return replace(path, opened.byLink);
    if (ftruncate(opened.file.get(), 0) != 0)
        throw cannotWriteTrace(path, errno);
    return std::move(opened.file);
}

} // namespace mihost
