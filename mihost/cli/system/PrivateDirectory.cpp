#include "mihost/cli/system/PrivateDirectory.h"

#include "mihost/cli/system/Failure.h"
#include "mihost/cli/system/Interrupts.h"
#include "mihost/cli/system/SignalBlock.h"
#include "mihost/sandbox/Folder.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fmt/format.h>
#include <fnmatch.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace mihost
{

namespace
{

constexpr char nameOfNew[] = "mihost-XXXXXX";
constexpr char nameOfAny[] = "mihost-??????";

std::string parentDirectory()
{
    char const* const wanted = std::getenv("TMPDIR");
    std::error_code ignored;
    return std::filesystem::absolute(wanted && *wanted ? wanted : "/tmp", ignored);
}

/** Whether only the caller can have put files into the directory. */
bool isOwn(Descriptor const& directory)
{
    struct stat status {
    };
    return fstat(directory.get(), &status) == 0 && S_ISDIR(status.st_mode) &&
           status.st_uid == geteuid() && (status.st_mode & 07777) == S_IRWXU;
}

/** Removes the files of a directory whose process has ended, and the directory if empty then. */
void removeIfLeft(Descriptor const& parent, std::string const& name)
{
    Descriptor const directory(
        openat(parent.get(), name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!directory || !isOwn(directory))
        return;
    // Another directory of the caller's that was renamed to this name has no lock file.
    Descriptor const lock(openat(directory.get(), privateDirectoryLock,
                                 O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
    if (!lock || flock(lock.get(), LOCK_EX | LOCK_NB) != 0)
        return;
    for (std::string const& file : namesIn(directory, name))
        if (file != privateDirectoryLock)
            unlinkat(directory.get(), file.c_str(), 0);
    // Removed last: without it no other process would try again.
    unlinkat(directory.get(), privateDirectoryLock, 0);
    unlinkat(parent.get(), name.c_str(), AT_REMOVEDIR);
}

void removeWhatWasLeft(std::string const& parent)
{
    Descriptor const opened(open(parent.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (!opened)
        return;
    try {
        for (std::string const& name : namesIn(opened, parent))
            if (fnmatch(nameOfAny, name.c_str(), 0) == 0)
                removeIfLeft(opened, name);
    } catch (std::system_error const&) {
        return; // another start may manage
    }
}

Failure cannotMakeIn(std::string const& parent)
{
    return {NoPlugin, fmt::format("cannot create a private directory in '{}': {}", parent,
                                  std::strerror(errno))};
}

} // namespace

PrivateDirectory::PrivateDirectory()
{
    std::string const parent = parentDirectory();
    SignalBlock const held; // no signal between creating it and recording it
    removeWhatWasLeft(parent);
    while (!make(parent)) {
    }
    previous_ = Descriptor(open(".", O_PATH | O_DIRECTORY | O_CLOEXEC));
    if (chdir(path_.c_str()) != 0) {
        int const problem = errno;
        remove();
        throw Failure(NoPlugin, fmt::format("cannot enter the private directory '{}': {}", path_,
                                            std::strerror(problem)));
    }
    interrupts::setFolderToRemove(path_.c_str());
}

PrivateDirectory::~PrivateDirectory()
{
    // If the previous directory is gone, use the root, to be able to remove this one.
    if (fchdir(previous_.get()) != 0 && chdir("/") != 0)
        std::perror("mihost: chdir");
    remove();
    interrupts::setFolderToRemove(nullptr);
}

bool PrivateDirectory::make(std::string const& parent)
{
    path_ = parent + "/" + nameOfNew;
    if (!mkdtemp(path_.data()))
        throw cannotMakeIn(parent);
    std::string const file = path_ + "/" + privateDirectoryLock;
    lock_ = Descriptor(open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600));
    if (!lock_) {
        Failure const failure = cannotMakeIn(parent);
        remove();
        throw failure;
    }
    flock(lock_.get(), LOCK_EX); // without file locks no leftover is removed
    struct stat status {
    };
    return fstat(lock_.get(), &status) == 0 && status.st_nlink > 0;
}

void PrivateDirectory::remove() const
{
    // This needs no descriptor, of which none may be left.
    for (char const* const file : privateDirectoryFiles)
        unlink((path_ + "/" + file).c_str());
    if (rmdir(path_.c_str()) == 0)
        return;
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
}

} // namespace mihost
