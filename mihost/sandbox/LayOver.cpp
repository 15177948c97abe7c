#include "mihost/sandbox/LayOver.h"

#include "mihost/sandbox/Content.h"
#include "mihost/sandbox/Folder.h"
#include "mihost/sandbox/Sandbox.h"
#include "mihost/sandbox/SystemCall.h"

#include <cstdio>
#include <fcntl.h>
#include <stdexcept>
#include <sys/stat.h>

namespace mihost
{

namespace
{

/** Whether there is a directory, possibly through a symbolic link. */
bool isFolder(std::string const& path)
{
    struct stat status {
    };
    return stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

void removeOld(std::string const& path)
{
    if (std::remove(path.c_str()) != 0 && errno != ENOENT)
        failed("cannot replace " + path);
}

mode_t modeFor(std::string const& path, mode_t given)
{
    bool const secret = path == "/etc/shadow" || path == "/etc/gshadow";
    return secret && (given & S_IROTH) != 0 ? S_IRUSR | S_IWUSR : given & 07777;
}

void layFile(Descriptor const& folder, std::string const& name, std::string const& path,
             mode_t mode)
{
    Descriptor const from(
        check(openat(folder.get(), name.c_str(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW),
              "cannot read the file for " + path));
    removeOld(path);
    Descriptor const to(
        check(open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, S_IRUSR | S_IWUSR),
              "cannot create " + path));
    copyContent(from, to, path);
    check(fchown(to.get(), 0, 0), "cannot set the owner of " + path);
    check(fchmod(to.get(), modeFor(path, mode)), "cannot set the mode of " + path);
}

void layLink(Descriptor const& folder, std::string const& name, std::string const& path,
             std::size_t length)
{
    std::string target(length, '\0');
    check(readlinkat(folder.get(), name.c_str(), target.data(), length),
          "cannot read the link for " + path);
    removeOld(path);
    check(symlink(target.c_str(), path.c_str()), "cannot create " + path);
    check(lchown(path.c_str(), 0, 0), "cannot set the owner of " + path);
}

void putFolder(std::string const& path, mode_t mode)
{
    if (isFolder(path))
        return;
    removeOld(path);
    check(mkdir(path.c_str(), S_IRWXU), "cannot create " + path);
    check(chown(path.c_str(), 0, 0), "cannot set the owner of " + path);
    check(chmod(path.c_str(), mode & 07777), "cannot set the mode of " + path);
}

void layFolder(Descriptor const& folder, std::string const& path)
{
    for (std::string const& name : namesIn(folder, path)) {
        std::string place = path;
        place.append("/").append(name);
        struct stat status {
        };
        check(fstatat(folder.get(), name.c_str(), &status, AT_SYMLINK_NOFOLLOW),
              "cannot look at the file for " + place);
        if (S_ISREG(status.st_mode)) {
            layFile(folder, name, place, status.st_mode);
        } else if (S_ISLNK(status.st_mode)) {
            layLink(folder, name, place, static_cast<std::size_t>(status.st_size));
        } else if (S_ISDIR(status.st_mode)) {
            putFolder(place, status.st_mode);
            layFolder(Descriptor(check(openat(folder.get(), name.c_str(),
                                              O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC),
                                       "cannot read the directory for " + place)),
                      place);
        } else {
            errno = EINVAL;
            failed("cannot lay over " + place + ", neither a file nor a link nor a directory");
        }
    }
}

} // namespace

Descriptor openFolder(std::string const& path)
{
    return Descriptor(check(open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC),
                            "cannot open the directory " + path));
}

void layOver(Descriptor const& folder)
{
    layFolder(folder, "");
}

void layOver(std::string const& folder)
{
    if (!inSandbox())
        throw std::logic_error("not in a sandbox: nothing is laid over");
    layOver(openFolder(folder));
}

} // namespace mihost
