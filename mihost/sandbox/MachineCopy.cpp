#include "mihost/sandbox/MachineCopy.h"

#include "mihost/sandbox/Content.h"
#include "mihost/sandbox/Descriptor.h"
#include "mihost/sandbox/Layers.h"
#include "mihost/sandbox/MountTable.h"
#include "mihost/sandbox/Self.h"
#include "mihost/sandbox/SystemCall.h"

#include <cstdlib>
#include <fcntl.h>
#include <sched.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace mihost
{

namespace
{

// Covered while the copy is made, and empty in the copy, so that nothing is missed below it.
std::string const stage = "/run";
std::string const copyRoot = stage + "/copy";

void mountAt(std::string const& path, char const* type, unsigned long flags,
             std::string const& options)
{
    check(mount(type, path.c_str(), type, flags, options.c_str()),
          std::string("cannot mount ") + type + " at " + path);
}

void makeFolder(std::string const& path, mode_t mode)
{
    if (mkdir(path.c_str(), mode) == 0)
        check(chmod(path.c_str(), mode), "cannot set the mode of " + path);
    else if (errno != EEXIST)
        failed("cannot create " + path);
}

void bindMount(std::string const& from, std::string const& to, unsigned long flags = 0)
{
    check(mount(from.c_str(), to.c_str(), nullptr, MS_BIND | flags, nullptr),
          "cannot bind " + from);
}

void makeReadOnly(std::string const& path)
{
    mount_attr attributes{};
    attributes.attr_set = MOUNT_ATTR_RDONLY;
    check(mount_setattr(AT_FDCWD, path.c_str(), AT_RECURSIVE, &attributes, sizeof attributes),
          "cannot make " + path + " read-only");
}

/** Overlays one file system of the machine each, all writes going to the stage. */
class Overlays
{
public:
    void add(std::string const& path)
    {
        std::string const layer = stage + "/" + std::to_string(count_++);
        std::string const upper = layer + "/upper";
        std::string const work = layer + "/work";
        struct stat status {
        };
        check(stat(path.c_str(), &status), "cannot look at " + path);
        makeFolder(layer, 0700);
        makeFolder(work, 0700);
        // The folder itself takes its owner and mode from here.
        makeFolder(upper, status.st_mode & 07777);
        check(chown(upper.c_str(), status.st_uid, status.st_gid), "cannot set the owner of a copy");
        // Named by ".", the path needs no escaping. Device files are dead in the copy.
        check(chdir(path.c_str()), "cannot enter " + path);
        // Without shortcuts every file that changes is in the layer; see CopyState.
        std::string const options =
            "lowerdir=.,upperdir=" + upper + ",workdir=" + work + ",redirect_dir=off,metacopy=off";
        check(mount("overlay", (copyRoot + path).c_str(), "overlay", MS_NODEV, options.c_str()),
              "cannot overlay " + path);
        layers().push_back({path == "/" ? "" : path, openReadOnly(path), openReadOnly(upper)});
    }

private:
    int count_ = 0;
};

void copyFile(std::string const& path, struct stat const& status)
{
    Descriptor const from(check(open(path.c_str(), O_RDONLY | O_CLOEXEC), "cannot read " + path));
    Descriptor const to(check(open((copyRoot + path).c_str(), O_WRONLY | O_TRUNC | O_CLOEXEC),
                              "cannot copy " + path));
    copyContent(from, to, path);
    check(fchown(to.get(), status.st_uid, status.st_gid), "cannot copy " + path);
    check(fchmod(to.get(), status.st_mode & 07777), "cannot copy " + path);
}

/** Mounts that cannot be copied are read-only; those that cannot even be bound are left out. */
void addMount(std::string const& path, Overlays& overlays)
{
    struct stat status {
    };
    if (stat(path.c_str(), &status) != 0)
        return;
    try {
        if (S_ISDIR(status.st_mode))
            overlays.add(path);
        else if (S_ISREG(status.st_mode))
            copyFile(path, status);
    } catch (std::system_error const&) {
        if (mount(path.c_str(), (copyRoot + path).c_str(), nullptr, MS_BIND, nullptr) == 0)
            makeReadOnly(copyRoot + path);
    }
}

void addDevices()
{
    std::string const devices = copyRoot + "/dev";
    mountAt(devices, "tmpfs", MS_NOSUID, "mode=0755");
    for (char const* name : {"null", "zero", "full", "random", "urandom", "tty"}) {
        std::string const device = std::string("/dev/") + name;
        std::string const place = copyRoot + device;
        if (access(device.c_str(), F_OK) != 0)
            continue;
        Descriptor const file(check(open(place.c_str(), O_CREAT | O_WRONLY | O_CLOEXEC, 0600),
                                    "cannot create " + place));
        bindMount(device, place);
        makeReadOnly(place); // the device can be written, its owner and mode cannot change
    }
    struct Link {
        char const* name;
        char const* target;
    };
    for (Link const& link : {Link{"fd", "/proc/self/fd"}, Link{"stdin", "/proc/self/fd/0"},
                             Link{"stdout", "/proc/self/fd/1"}, Link{"stderr", "/proc/self/fd/2"},
                             Link{"ptmx", "pts/ptmx"}})
        check(symlink(link.target, (devices + "/" + link.name).c_str()),
              std::string("cannot create /dev/") + link.name);
    makeFolder(devices + "/pts", 0755);
    mountAt(devices + "/pts", "devpts", MS_NOSUID | MS_NOEXEC,
            "newinstance,ptmxmode=0666,mode=0620,gid=5");
    makeFolder(devices + "/shm", 01777);
    mountAt(devices + "/shm", "tmpfs", MS_NOSUID | MS_NODEV, "mode=1777");
}

void addKernelFileSystems()
{
    std::string const processes = copyRoot + "/proc";
    mountAt(processes, "proc", MS_NOSUID | MS_NODEV | MS_NOEXEC, "");
    // Writing to these would reach the machine itself.
    for (char const* name : {"acpi", "bus", "fs", "irq", "scsi", "sys", "sysrq-trigger"}) {
        std::string const path = processes + "/" + name;
        if (access(path.c_str(), F_OK) != 0)
            continue;
        bindMount(path, path);
        makeReadOnly(path);
    }
    if (access("/sys", F_OK) == 0) {
        bindMount("/sys", copyRoot + "/sys", MS_REC);
        makeReadOnly(copyRoot + "/sys");
    }
}

Descriptor openRoot(std::string const& path)
{
    return Descriptor(
        check(open(path.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC), "cannot open " + path));
}

void changeRoot(Descriptor const& root)
{
    check(fchdir(root.get()), "cannot enter a root");
    check(chroot("."), "cannot change the root");
}

/**
 * Keeps later mounts from reaching the machine.
 *
 * The caller's root need not be a mount point: it may be any directory, as in a chroot. So this
 * uses the root of the mount namespace, and with it every mount.
 *
 * @return that root
 */
Descriptor keepMountsPrivate()
{
    Descriptor const ownRoot = openRoot("/");
    check(setns(openSelf().get(), CLONE_NEWNS), "cannot enter the root of all mounts");
    Descriptor top = openRoot("/");
    check(mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr), "cannot keep mounts private");
    changeRoot(ownRoot);
    return top;
}

/** From its own /proc: the machine's may be missing, as in a chroot. */
std::vector<std::string> readMounts()
{
    mountAt(stage, "proc", MS_NOSUID | MS_NODEV | MS_NOEXEC, "");
    std::vector<std::string> mounts = mountsToCopy(stage + "/self/mountinfo");
    check(umount2(stage.c_str(), MNT_DETACH), "cannot leave " + stage);
    return mounts;
}

/** @param top  the root of all mounts: only from there another one can take its place */
void makeRoot(std::string const& root, Descriptor const& top)
{
    Descriptor const copy = openRoot(root);
    changeRoot(top);
    check(fchdir(copy.get()), "cannot enter the copy");
    check(syscall(SYS_pivot_root, ".", "."), "cannot make the copy the root");
    check(umount2(".", MNT_DETACH), "cannot leave the machine's own files");
    check(chdir("/"), "cannot enter the copy");
}

} // namespace

void enterMachineCopy()
{
    char* const there = getcwd(nullptr, 0);
    std::string const workingDirectory = there ? there : "/";
    std::free(there);

    Descriptor const top = keepMountsPrivate();
    std::vector<std::string> const mounts = readMounts();
    mountAt(stage, "tmpfs", MS_NODEV, "mode=0700");
    makeFolder(copyRoot, 0755);
    Overlays overlays;
    overlays.add("/");
    for (std::string const& path : mounts)
        addMount(path, overlays);
    for (char const* name : {"/proc", "/sys", "/dev", "/run"})
        makeFolder(copyRoot + name, 0755);
    addKernelFileSystems();
    addDevices();
    mountAt(copyRoot + "/run", "tmpfs", MS_NOSUID | MS_NODEV, "mode=0755");
    makeRoot(copyRoot, top);
    if (chdir(workingDirectory.c_str()) != 0)
        check(chdir("/"), "cannot enter the copy");
}

} // namespace mihost
