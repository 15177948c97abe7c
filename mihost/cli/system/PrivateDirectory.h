#ifndef MIHOST_CLI_SYSTEM_PRIVATEDIRECTORY_H
#define MIHOST_CLI_SYSTEM_PRIVATEDIRECTORY_H

#include "mihost/sandbox/Descriptor.h"

#include <string>

namespace mihost
{

/**
 * A working directory that nobody else can read, since the plug-in writes a password hash to a file
 * there. The destructor removes it with its contents and restores the previous working directory.
 *
 * It contains a lock file, locked while its process lives. A killed process's directory is removed
 * when the next one creates its own.
 */
class PrivateDirectory
{
public:
    /** @throws Failure if it cannot be created */
    PrivateDirectory();
    ~PrivateDirectory();
    PrivateDirectory(PrivateDirectory const&) = delete;
    PrivateDirectory& operator=(PrivateDirectory const&) = delete;

    std::string const& path() const
    {
        return path_;
    }

private:
    /** @return false if another process took it for left before it was locked, and removed it */
    bool make(std::string const& parent);
    void remove() const;

    std::string path_;
    Descriptor lock_;
    Descriptor previous_;
};

constexpr char privateDirectoryLock[] = "mihost.lock";

/** The files that are usually in it, for a signal handler to remove. */
constexpr char const* privateDirectoryFiles[] = {"usrandpwd", privateDirectoryLock};

} // namespace mihost

#endif
